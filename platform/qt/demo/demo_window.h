// The demo report-selection screen: the four controls on one form, a panel with what the
// report would receive from each, the host's answers to the controls' list buttons, and the
// form's properties saved to and loaded from a form file.
#pragma once

#include <QMainWindow>
#include <QPlainTextEdit>
#include <QString>

#include "ryx/qt/widgets.h"

class DemoWindow : public QMainWindow {
    Q_OBJECT
  public:
    explicit DemoWindow(const QString& databasePath, QWidget* parent = nullptr);
    ~DemoWindow() override;

    ryx::qt::PolicyStatusWidget& policyStatus() const { return *policyStatus_; }
    ryx::qt::AgencySelectionWidget& agencies() const { return *agencies_; }
    ryx::qt::DateRangeWidget& dateRange() const { return *dateRange_; }
    ryx::qt::RangeSelectorWidget& rangeSelector() const { return *rangeSelector_; }

    // What a host reads from each control, in both syntaxes.
    QString criteria();
    void saveForm(const QString& path);
    void loadForm(const QString& path);

  signals:
    void criteriaShown(const QString& text);

  private:
    void buildMenu();
    void scheduleRefresh();
    void refreshCriteria();
    bool editingDates() const;
    void pickDate(ryx::EventArgs& args);
    void pickPolicy(ryx::EventArgs& args);
    void chooseAndSave();
    void chooseAndLoad();

    ryx::qt::PolicyStatusWidget* policyStatus_;
    ryx::qt::AgencySelectionWidget* agencies_;
    ryx::qt::DateRangeWidget* dateRange_;
    ryx::qt::RangeSelectorWidget* rangeSelector_;
    QPlainTextEdit* panel_;
    bool refreshScheduled_ = false;
};
