#pragma once

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/commands/Settings.h"
#include "app/views/StatusAction.h"

class SongListWidget;

// The batch commands about the songs that the list has marked, and those that take them off the disk. Each
// tells itself what came of it.
class BatchCommands : public SettingsClient {
 public:
    BatchCommands(TMusicDatabase& database, SongListWidget& list);

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 private:
    BatchSongs Chosen() const;
    void AdaptGenre();
    void VerifyLengths();
    void EnterLength();
    void ChangeFlag(int id);
    void RemoveTags();
    void RereadTags();
    void Discard(int id);
    void RenameByPattern();
    void TakeTagsFromNames();
    void EditBannList();
    void PrepareBurning();
    void OfferBurning(const QString& folder);

    TMusicDatabase& database_;
    SongListWidget& list_;
    QString tagPattern_;  // of the last time that tags were taken from names
    StatusAction burn_{QStringLiteral("burn")};
    Subscriptions handlers_;
};
