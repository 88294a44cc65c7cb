#pragma once

#include <QString>
#include <functional>

#include "CommonRUKTools/Listeners.h"
#include "HTTPRetrieval/OnlineSearch.h"
#include "MusicManagment/database/SongList.h"
#include "MusicManagment/database/commands/Settings.h"

class QWidget;
class TID3TagForm;
class TMusicDatabase;

// The search in the Internet: asks what to look for, shows what a service has found, and brings a hit or a
// cover into the tag editor, where the user decides about it. Nothing is asked of anybody by itself.
class OnlineCommands : public SettingsClient {
 public:
    // The windows belong to `window`.
    OnlineCommands(QWidget& window, TMusicDatabase& database, TID3TagForm& tags);

    // Told how it goes, in a sentence for the status bar.
    std::function<void(const QString&)> OnNotice;
    // Wants the tag editor to have the songs that are chosen in the list now.
    std::function<void()> OnNeedChoice;

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 private:
    void Search();
    void Show(HitSource hits);
    void Take(const SearchHit& hit);
    void FetchCover(const SearchHit& hit);
    void TakeCover(const QByteArray& picture);
    void Notice(const QString& sentence) const;

    QWidget& window_;
    TID3TagForm& tags_;
    OnlineServices services_;
    OnlineSearch search_;
    THTTPGet cover_;
    SongHandle coverSong_{};  // that the cover is fetched for
    QString query_;           // the last one
    Subscriptions handlers_;
};
