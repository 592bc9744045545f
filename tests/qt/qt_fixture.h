// A window holding controls between two plain line edits, shown and active, for tests that
// send real key and mouse events.
#pragma once

#include <gtest/gtest.h>

#include <QApplication>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QListView>
#include <QTest>
#include <QWidget>

#include "form_fixture.h"
#include "ryx/qt/control_host.h"

namespace ryx::testing {

class QtWindow {
  public:
    QtWindow() {
        layout_ = new QHBoxLayout(&window_);
        before = new QLineEdit(&window_);
        before->setObjectName("before");
        layout_->addWidget(before);
    }
    template <class W>
    W& add() {
        auto* w = new W(&window_);
        layout_->addWidget(w);
        return *w;
    }
    void finish() {
        after = new QLineEdit(&window_);
        after->setObjectName("after");
        layout_->addWidget(after);
        window_.show();
        window_.activateWindow();
        EXPECT_TRUE(QTest::qWaitForWindowActive(&window_));
    }
    QWidget& window() { return window_; }
    QString focusName() const {
        QWidget* f = QApplication::focusWidget();
        return f ? f->objectName() : QString("(none)");
    }

    QLineEdit* before = nullptr;
    QLineEdit* after = nullptr;

  private:
    QWidget window_;
    QHBoxLayout* layout_;
};

// Clicks row `row` of a list view as a person would.
inline void clickRow(QWidget* listWidget, int row) {
    auto* view = qobject_cast<QListView*>(listWidget);
    ASSERT_NE(view, nullptr);
    QApplication::processEvents();
    view->scrollTo(view->model()->index(row, 0));
    const QRect r = view->visualRect(view->model()->index(row, 0));
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, r.center());
}

}  // namespace ryx::testing
