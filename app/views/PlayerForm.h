#pragma once

#include <QDockWidget>

class TPlayList;
class TPlaySound;
class TVisPlaySound;

// The tool window of the player.
class TPlayerForm : public QDockWidget {
 public:
    TPlayerForm(TPlaySound& player, const TPlayList& list, QWidget* parent = nullptr);

    TVisPlaySound& Panel() { return *panel_; }

 private:
    void FitTitle();

    TVisPlaySound* panel_;
};
