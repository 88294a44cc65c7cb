#pragma once

#include <QHash>
#include <QList>
#include <functional>

class QAction;
class QMenu;
class QMenuBar;
class TMenuExItem;
class TMusicDatabase;

// The main window's menu: the command menu of the database as the toolkit shows it, and "Beenden".
class MainMenu {
 public:
    // `run` is given the number of the chosen command.
    MainMenu(QMenuBar& bar, TMusicDatabase& database, std::function<void(int id)> run,
             std::function<void()> exit);

    // Adds the items for the options and the set-up to the end of the menu "Extras".
    void AddSettings(std::function<void()> options, std::function<void()> wizard);
    // While a long operation runs every command of the database rests.
    void SetRunning(bool running);
    // Enables, disables and marks the items as the database's menu says now.
    void Update();
    // Chosen for a song, from its context menu. The caller shows it.
    QMenu& SongMenu() const { return *songMenu_; }

 private:
    void AddItems(QMenu& menu, const TMenuExItem& item);
    void AddCommand(QMenu& menu, const TMenuExItem& item);

    TMusicDatabase& database_;
    std::function<void(int)> run_;
    QHash<int, QAction*> actions_;  // by number
    QList<QAction*> settings_;
    QMenu* songMenu_ = nullptr;
    QMenu* extrasMenu_ = nullptr;
    bool running_ = false;
};
