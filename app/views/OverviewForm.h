#pragma once

#include <QDockWidget>

class TMusicDatabase;
class TMusicOverview;

// The tool window of the overview.
class TOverviewForm : public QDockWidget {
 public:
    explicit TOverviewForm(TMusicDatabase& database, QWidget* parent = nullptr);

    TMusicOverview& Overview() { return *overview_; }

 private:
    TMusicOverview* overview_;
};
