#include "scripted_session.h"

#include <QApplication>
#include <QListView>
#include <QTest>
#include <iostream>

#include "demo_window.h"

namespace {

void say(const std::string& what) {
    std::cout << what << "\n";
}

void clickRow(QWidget* list, int row) {
    auto* view = qobject_cast<QListView*>(list);
    QApplication::processEvents();
    view->scrollTo(view->model()->index(row, 0));
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {},
                      view->visualRect(view->model()->index(row, 0)).center());
}

void typeInto(QWidget* w, const char* keys) {
    w->setFocus();
    QTest::keyClicks(w, keys);
}

}  // namespace

int runScriptedSession(DemoWindow& window, const QString& screenshot) {
    window.activateWindow();
    if (!QTest::qWaitForWindowActive(&window)) std::cerr << "the window did not become active\n";

    say("The user picks \"In - Force\" and \"Fully PaidUp\"");
    QWidget* statuses = window.policyStatus().childWidget("LstPolicyStatus");
    clickRow(statuses, 0);
    clickRow(statuses, 3);

    say("The user picks two agencies and \"*   Others\"");
    QWidget* agencies = window.agencies().childWidget("LstAgMast");
    clickRow(agencies, 0);
    clickRow(agencies, 2);
    clickRow(agencies, 3);

    say("The user types 15/05/2001 and 10/02/2003 in the financial-year dates, then Tab");
    typeInto(window.dateRange().childWidget("MskDate", 0), "15/05/2001");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Down);
    QTest::keyClicks(QApplication::focusWidget(), "10/02/2003");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);

    say("The user types policy numbers 1000100, Enter, 1000500");
    typeInto(window.rangeSelector().childWidget("RYXT", 0), "1000100");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
    QTest::keyClicks(QApplication::focusWidget(), "1000500");
    window.policyStatus().childWidget("LstPolicyStatus")->setFocus();
    QApplication::processEvents();

    say("");
    say("What the report receives:");
    std::cout << window.criteria().toStdString();

    QApplication::processEvents();
    if (!window.grab().save(screenshot)) {
        std::cerr << "cannot write the screenshot " << screenshot.toStdString() << "\n";
        return 1;
    }
    say("");
    say("Screenshot: " + screenshot.toStdString());
    return 0;
}
