#pragma once

#include <QList>

#include "CommonRUKTools/Listeners.h"
#include "app/CommandMenu.h"

class QMenuBar;

// The main window's menu: the commands of the database as the toolkit shows them.
class MainMenu {
 public:
    MainMenu(QMenuBar& bar, CommandDispatcher& commands);

    // The keys of commands that are about single songs then work only in their list.
    void BindTo(QWidget& songList);
    // The one with "Abspielen", for the context menu of a song; nullptr where the user has arranged the menu
    // without. The caller shows it.
    QMenu* SongMenu() const { return songMenu_; }

 private:
    void Build();
    void BuildWhenOther();

    QMenuBar& bar_;
    CommandDispatcher& commands_;
    QList<QMenu*> menus_;
    CommandMenu shown_;
    int revision_ = 0;  // of the menu that is shown
    QMenu* songMenu_ = nullptr;
    Subscription changes_;
};
