#pragma once

#include <QString>

#include "app/desktop/Arrangement.h"

class QMainWindow;
class QMenu;
class SongListWidget;

// Keeps how the windows stand in a file of the user's, and puts them back.
class ArrangementCommands {
 public:
    ArrangementCommands(QMainWindow& window, SongListWidget& list) : window_(window), list_(list) {}

    // The caller keeps this object as long as the menu.
    void AddTo(QMenu& menu);
    // Throws EStreamError when the file cannot be used; the windows then stay as they are.
    void Load(const QString& path);

 private:
    void SaveAs();
    void Open();
    Arrangement Current() const;
    bool Apply(const Arrangement& arrangement);

    QMainWindow& window_;
    SongListWidget& list_;
};
