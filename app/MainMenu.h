#pragma once

#include <QList>
#include <functional>

#include "app/CommandMenu.h"
#include "app/MenuIcons.h"

class QMenuBar;
class TMusicDatabase;

// The main window's menu: the command menu of the database as the toolkit shows it, and "Beenden".
class MainMenu {
 public:
    // `run` is given the number of the chosen command.
    MainMenu(QMenuBar& bar, TMusicDatabase& database, std::function<void(int id)> run,
             std::function<void()> exit);

    // The keys of commands that are about single songs then work only in their list.
    void BindTo(QWidget& songList);
    // Adds the items for the options and the set-up, to the end of the menu "Extras" where there is one.
    void AddSettings(std::function<void()> options, std::function<void()> wizard);
    // While a long operation runs every command of the database rests.
    void SetRunning(bool running);
    // Enables, disables and marks the items as the database's menu says now; builds them anew when the
    // database has become writable or has ceased to be.
    void Update();
    // Chosen for a song, from its context menu. The caller shows it.
    QMenu& SongMenu() const { return *songMenu_; }

 private:
    void Build();
    void BuildSettings(QMenu& menu);
    void AddExit();
    void Run(int id);

    QMenuBar& bar_;
    TMusicDatabase& database_;
    std::function<void(int)> run_;
    std::function<void()> exit_;
    std::function<void()> options_;
    std::function<void()> wizard_;
    QList<QMenu*> menus_;
    CommandMenu commands_{[this](int id) { Run(id); }, &MenuIcon};
    bool readOnly_ = false;  // as the menus were built for
    QList<QAction*> settings_;
    QMenu* songMenu_ = nullptr;
    bool running_ = false;
};
