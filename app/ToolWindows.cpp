#include "app/ToolWindows.h"

#include <QMainWindow>
#include <QMenu>

#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/MusicManagment.h"
#include "app/views/DockAction.h"
#include "app/views/MusicOverview.h"
#include "app/views/OverviewForm.h"
#include "app/views/PropertyForm.h"
#include "app/views/TagForm.h"

ToolWindows::ToolWindows(QMainWindow& window, TMusicDatabase& database)
    : window_(window),
      database_(database),
      overview_(new TOverviewForm(database, &window)),
      properties_(new TPropertyForm(database, &window)),
      tag_(new TID3TagForm(database, &window)) {
    window.addDockWidget(Qt::LeftDockWidgetArea, overview_);
    window.addDockWidget(Qt::RightDockWidgetArea, properties_);
    window.tabifyDockWidget(properties_, tag_);
    properties_->raise();
    // A first look at the program is a look at the songs; these two are for those who want to know more.
    properties_->hide();
    tag_->hide();
    overview_->Overview().OnSelectionChanged = [this](const GroupSelection& selection) {
        if (OnSelectionChanged) OnSelectionChanged(selection);
    };
    overview_->Overview().OnTypeChanged = [&database](TOVType) { database.Commands().Changed.Tell(); };
    HandleCommands(database);
    FollowSong();
}

void ToolWindows::LieBehind(QDockWidget& front) {
    window_.tabifyDockWidget(&front, properties_);
    window_.tabifyDockWidget(properties_, tag_);
    front.raise();
}

void ToolWindows::FollowSong() {
    CollectionEvents& events = database_.Events();
    subscriptions_ += events.Changed.Subscribe([this](SongIndex index, const TID3Tag&, const TID3Tag& song) {
        if (index == database_.Songs().PositionOf(song_)) properties_->ShowSong(&song);
    });
    const auto forget = [this] {
        if (database_.Songs().Find(song_) == nullptr) properties_->ShowSong(nullptr);
    };
    subscriptions_ += events.Replaced.Subscribe(forget);
    subscriptions_ += events.Cleared.Subscribe(forget);
}

void ToolWindows::HandleCommands(TMusicDatabase& database) {
    for (int i = 0; i < kOverviewTypeCount; ++i) {
        const auto type = static_cast<TOVType>(i);
        const auto show = [this, type] {
            overview_->show();
            overview_->raise();
            overview_->Overview().SetOVType(type);
        };
        const auto isShown = [this, type] { return overview_->Overview().OVType() == type; };
        handlers_ += database.Commands().Handle(mcListArtists + i, {.Run = show, .IsOn = isShown});
    }
}

void ToolWindows::ShowSong(const TID3Tag* song) {
    song_ = song != nullptr ? database_.Songs().HandleOf(*song) : SongHandle();
    properties_->ShowSong(song);
}

void ToolWindows::AddTo(QMenu& menu) {
    for (QDockWidget* window : {static_cast<QDockWidget*>(overview_), static_cast<QDockWidget*>(properties_),
                                static_cast<QDockWidget*>(tag_)})
        AddDockAction(menu, *window);
}
