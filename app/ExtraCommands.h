#pragma once

#include <QPointer>

#include "CommonRUKTools/Listeners.h"

class QWidget;
class SimilarArtistsForm;
class TMusicDatabase;

// Commands about the whole collection that have windows of their own, in which the user decides row by row.
class ExtraCommands {
 public:
    // The windows belong to `window`.
    ExtraCommands(QWidget& window, TMusicDatabase& database);

 private:
    void FindSimilarArtists();
    void ReadBackup();

    QWidget& window_;
    TMusicDatabase& database_;
    QPointer<SimilarArtistsForm> artists_;
    Subscriptions handlers_;
};
