#pragma once

#include <QPointer>
#include <QWidget>
#include <functional>

#include "MusicManagment/database/commands/Settings.h"
#include "app/models/GroupSelection.h"
#include "app/models/OverviewModel.h"

class QComboBox;
class QLineEdit;
class QTreeView;

// Lists the artists, albums, years, lengths or genres of the collection; the groups that are chosen in it
// narrow the song list.
class TMusicOverview : public QWidget, public SettingsClient {
 public:
    explicit TMusicOverview(TMusicDatabase& database, QWidget* parent = nullptr);
    ~TMusicOverview() override;

    // Raised when other groups are chosen, also because a chosen one has gone.
    std::function<void(const GroupSelection& selection)> OnSelectionChanged;
    // Raised when the user or the settings have switched to another list.
    std::function<void(TOVType type)> OnTypeChanged;

    TOVType OVType() const { return model_.Type(); }
    void SetOVType(TOVType type);
    const GroupSelection& Selection() const { return selection_; }
    // Nothing is chosen afterwards.
    void ClearSelection();

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 protected:
    void changeEvent(QEvent* event) override;

 private:
    void SetUpSwitch();
    void SetUpFilter();
    void SetUpList();
    void FitToFont();
    GroupSelection ReadSelection() const;
    void FollowSelection();

    QPointer<TMusicDatabase> database_;
    OverviewModel model_;
    GroupSelection selection_;
    QComboBox* switch_;
    QLineEdit* filter_;
    QTreeView* list_;
};
