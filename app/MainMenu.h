#pragma once

#include <QList>

#include "CommonRUKTools/Listeners.h"
#include "app/CommandMenu.h"

class QMenuBar;
class TMusicDatabase;

// The main window's menu: the commands of the database as the toolkit shows them, always as they are now.
class MainMenu {
 public:
    MainMenu(QMenuBar& bar, TMusicDatabase& database);

    // The keys of commands that are about single songs then work only in their list.
    void BindTo(QWidget& songList);
    // Chosen for a song, from its context menu. The caller shows it.
    QMenu& SongMenu() const { return *songMenu_; }

 private:
    void Build();
    void Update();

    QMenuBar& bar_;
    TMusicDatabase& database_;
    QList<QMenu*> menus_;
    CommandMenu commands_;
    int revision_ = 0;  // of the database's menu that is shown
    QMenu* songMenu_ = nullptr;
    Subscription changes_;
};
