#include "demo_window.h"

#include <QApplication>
#include <QCalendarWidget>
#include <QDate>
#include <QFileDialog>
#include <QFontDatabase>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QListWidget>
#include <QMenuBar>
#include <QStatusBar>
#include <QTimer>
#include <QVBoxLayout>

#include "ryx/common/form_document.h"
#include "ryx/errors.h"

using namespace ryx;
using namespace ryx::qt;

namespace {

// The policy numbers the host offers when the range selector asks for its list.
QStringList policyNumbers() {
    QStringList numbers;
    for (int i = 0; i < 40; ++i)
        numbers << QString::number(1000100 + i * 25);
    return numbers;
}

QString text(const std::string& s) {
    return QString::fromStdString(s);
}

// A Variant as the host sees it: its text, or (empty) for no value at all.
QString shown(const Variant& v) {
    if (v.isEmpty()) return "(empty)";
    return "\"" + text(v.toString()) + "\"";
}

QLabel* caption(const QString& what) {
    auto* label = new QLabel(what);
    label->setStyleSheet("color: #555; font-size: 8pt;");
    return label;
}

}  // namespace

DemoWindow::DemoWindow(const QString& databasePath, QWidget* parent) : QMainWindow(parent) {
    setWindowTitle("RYXReport demo: report selection");
    auto* central = new QWidget(this);
    auto* grid = new QGridLayout(central);

    policyStatus_ = new PolicyStatusWidget(central);
    agencies_ = new AgencySelectionWidget(central);
    dateRange_ = new DateRangeWidget(central);
    rangeSelector_ = new RangeSelectorWidget(central);
    policyStatus_->setObjectName("PolicyStatus1");
    agencies_->setObjectName("AgencySelection1");
    dateRange_->setObjectName("DateRange1");
    rangeSelector_->setObjectName("RangeSelector1");

    grid->addWidget(caption("Policy statuses"), 0, 0);
    grid->addWidget(policyStatus_, 1, 0, Qt::AlignLeft | Qt::AlignTop);
    grid->addWidget(caption("Agencies"), 0, 1);
    grid->addWidget(agencies_, 1, 1, Qt::AlignLeft | Qt::AlignTop);
    grid->addWidget(caption("Period (financial year)"), 2, 0);
    grid->addWidget(dateRange_, 3, 0, Qt::AlignLeft | Qt::AlignTop);
    grid->addWidget(caption("Policy numbers"), 2, 1);
    grid->addWidget(rangeSelector_, 3, 1, Qt::AlignLeft | Qt::AlignTop);

    auto* box = new QGroupBox("What the report receives", central);
    auto* boxLayout = new QVBoxLayout(box);
    panel_ = new QPlainTextEdit(box);
    panel_->setReadOnly(true);
    panel_->setFocusPolicy(Qt::NoFocus);
    panel_->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    panel_->setMinimumWidth(380);
    boxLayout->addWidget(panel_);
    grid->addWidget(box, 0, 2, 4, 1);
    grid->setColumnStretch(2, 1);
    setCentralWidget(central);
    buildMenu();

    // What only the host knows at run time.
    dateRange_->control().setDateStyle(RYXDtRgStyle::RYXDtRgFinancialYear);
    rangeSelector_->control().setControlType("policyno");
    try {
        agencies_->control().setDatabaseName(databasePath.toStdString());
    } catch (const ryx::Error& e) {
        statusBar()->showMessage(QString::fromStdString(e.what()));
    }

    for (ControlHost* host : std::initializer_list<ControlHost*>{policyStatus_, agencies_,
                                                                 dateRange_, rangeSelector_}) {
        connect(host, &ControlHost::eventRaised, this,
                [this](int, EventArgs&) { scheduleRefresh(); });
    }
    connect(dateRange_, &ControlHost::ButtonClick, this, [this](EventArgs& a) { pickDate(a); });
    connect(rangeSelector_, &ControlHost::ButtonClick, this,
            [this](EventArgs& a) { pickPolicy(a); });
    connect(qApp, &QApplication::focusChanged, this, [this] { scheduleRefresh(); });
    dateRange_->childWidget("MskDate", 0)->setFocus();
    refreshCriteria();
}

DemoWindow::~DemoWindow() {
    // Focus changes while the widgets go must not reach a window that is half destroyed.
    disconnect(qApp, nullptr, this, nullptr);
}

void DemoWindow::buildMenu() {
    QMenu* file = menuBar()->addMenu("&Form");
    file->addAction("&Open form file...", QKeySequence::Open, this, [this] { chooseAndLoad(); });
    file->addAction("&Save form file...", QKeySequence::Save, this, [this] { chooseAndSave(); });
    file->addSeparator();
    file->addAction("&Quit", QKeySequence::Quit, this, [this] { close(); });
}

// The panel follows every event of the controls; a burst of events costs one refresh.
void DemoWindow::scheduleRefresh() {
    if (refreshScheduled_) return;
    refreshScheduled_ = true;
    QTimer::singleShot(0, this, [this] {
        refreshScheduled_ = false;
        refreshCriteria();
    });
}

void DemoWindow::refreshCriteria() {
    const QString shown = criteria();
    if (shown == panel_->toPlainText()) return;
    panel_->setPlainText(shown);
    emit criteriaShown(shown);
}

// Reading a date repairs and fills the boxes, so the panel waits until the user has left them.
bool DemoWindow::editingDates() const {
    QWidget* focus = QApplication::focusWidget();
    return focus && dateRange_->isAncestorOf(focus);
}

QString DemoWindow::criteria() {
    QString out;
    auto line = [&](const QString& what, const QString& formula, const QString& plain) {
        out += QString("%1\n  formula: %2\n  plain:   %3\n").arg(what, formula, plain);
    };
    auto bothSyntaxes = [](auto& control, auto read) {
        const bool crystal = control.CrystalStyle();
        control.setCrystalStyle(true);
        const QString formula = read();
        control.setCrystalStyle(false);
        const QString plain = read();
        control.setCrystalStyle(crystal);
        return std::pair{formula, plain};
    };

    RYXPolicyStatus& ps = policyStatus_->control();
    auto [psFormula, psPlain] = bothSyntaxes(ps, [&] { return text(ps.ReturnedText()); });
    line("Policy status ReturnedText", psFormula, psPlain);
    out += "  DefaultSetting: " + shown(ps.DefaultSetting()) + "\n";

    RYXAgencySelection& ag = agencies_->control();
    try {
        auto [agFormula, agPlain] = bothSyntaxes(ag, [&] { return text(ag.ReturnedText()); });
        line("Agencies ReturnedText", agFormula, agPlain);
        out += "  DefaultSetting: " + shown(ag.DefaultSetting()) + "\n";
    } catch (const ryx::Error& e) {
        out += "Agencies: " + text(e.what()) + "\n";
    }

    RYXDateRange& dr = dateRange_->control();
    if (editingDates()) {
        out += "Date range StartDate, EndDate\n  (read when the focus leaves the dates)\n";
    } else {
        auto [start, startPlain] = bothSyntaxes(dr, [&] { return shown(dr.StartDate()); });
        auto [end, endPlain] = bothSyntaxes(dr, [&] { return shown(dr.EndDate()); });
        line("Date range StartDate", start, startPlain);
        line("Date range EndDate", end, endPlain);
    }

    RYXRangeSelector& rs = rangeSelector_->control();
    out += "Range selector\n  StartText: \"" + text(rs.StartText()) + "\"\n  EndText:   \"" +
           text(rs.EndText()) + "\"\n";
    return out;
}

// The host's answer to a calendar image: a calendar, whose pick becomes the date.
void DemoWindow::pickDate(EventArgs& args) {
    const int index = args.Index.toInt32();
    auto* popup = new QCalendarWidget(this);
    popup->setWindowFlags(Qt::Popup);
    popup->setAttribute(Qt::WA_DeleteOnClose);
    QWidget* image = dateRange_->childWidget("ImgCalendar", static_cast<int16_t>(index));
    popup->move(image->mapToGlobal(QPoint(0, image->height())));
    RYXDateRange& dr = dateRange_->control();
    connect(popup, &QCalendarWidget::clicked, this, [this, popup, index, &dr](QDate date) {
        const std::string picked = date.toString("dd/MM/yyyy").toStdString();
        if (index == 0)
            dr.setStartDate(picked);
        else
            dr.setEndDate(picked);
        popup->close();
        scheduleRefresh();
    });
    connect(popup, &QObject::destroyed, this, [&dr] { dr.ImageClick = false; });
    popup->show();
}

// The host's answer to the range selector's list button: its policy numbers.
void DemoWindow::pickPolicy(EventArgs& args) {
    const int index = args.Index.toInt32();
    auto* popup = new QListWidget(this);
    popup->setWindowFlags(Qt::Popup);
    popup->setAttribute(Qt::WA_DeleteOnClose);
    popup->addItems(policyNumbers());
    popup->resize(160, 220);
    QWidget* box = rangeSelector_->childWidget("RYXT", static_cast<int16_t>(index));
    popup->move(box->mapToGlobal(QPoint(0, box->height())));
    connect(popup, &QListWidget::itemActivated, this, [this, popup, index](QListWidgetItem* item) {
        RYXRangeSelector& rs = rangeSelector_->control();
        if (index == 0)
            rs.setStartText(item->text().toStdString());
        else
            rs.setEndText(item->text().toStdString());
        popup->close();
        scheduleRefresh();
    });
    popup->show();
    popup->setFocus();
}

void DemoWindow::saveForm(const QString& path) {
    const std::vector<common::FormControl> controls{
        {"PolicyStatus1", &policyStatus_->control()},
        {"AgencySelection1", &agencies_->control()},
        {"DateRange1", &dateRange_->control()},
        {"RangeSelector1", &rangeSelector_->control()},
    };
    common::writeFormFile(path.toStdString(), common::formToJson(controls));
}

void DemoWindow::loadForm(const QString& path) {
    const std::string file = path.toStdString();
    for (common::FormEntry& entry : common::parseForm(common::readFormFile(file), file)) {
        for (ControlHost* host : std::initializer_list<ControlHost*>{policyStatus_, agencies_,
                                                                     dateRange_, rangeSelector_}) {
            if (host->objectName().toStdString() != entry.name) continue;
            if (host->hostedControl().typeName() != entry.type) continue;
            host->hostedControl().ReadProperties(entry.properties);
            host->hostedControl().Resize();
        }
    }
    scheduleRefresh();
}

void DemoWindow::chooseAndSave() {
    const QString path = QFileDialog::getSaveFileName(this, "Save form file", "criteria.json",
                                                      "Form files (*.json)");
    if (path.isEmpty()) return;
    try {
        saveForm(path);
        statusBar()->showMessage("Saved " + path, 5000);
    } catch (const ryx::Error& e) {
        statusBar()->showMessage(text(e.what()));
    }
}

void DemoWindow::chooseAndLoad() {
    const QString path =
        QFileDialog::getOpenFileName(this, "Open form file", {}, "Form files (*.json)");
    if (path.isEmpty()) return;
    try {
        loadForm(path);
        statusBar()->showMessage("Loaded " + path, 5000);
    } catch (const ryx::Error& e) {
        statusBar()->showMessage(text(e.what()));
    }
}
