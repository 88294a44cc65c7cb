#pragma once

#include <QString>
#include <QStringList>
#include <functional>
#include <vector>

#include "CommonRUKTools/Listeners.h"

class TMusicDatabase;

// Something that was done with the songs of a collection and can be taken back.
struct UndoStep {
    QString Caption;  // what it was, as a menu names it
    // Takes it back; returns the paths of the songs that it is about. May throw.
    std::function<QStringList()> TakeBack;
};

// What can be taken back, the last step first. It belongs to one collection and is empty when another one
// begins.
class UndoList {
 public:
    explicit UndoList(TMusicDatabase& database);

    void Add(UndoStep step);
    bool IsEmpty() const { return steps_.empty(); }
    // Of the last step; empty when there is none.
    QString Caption() const { return steps_.empty() ? QString() : steps_.back().Caption; }
    // Takes the last step back and returns the paths of its songs. Throws what the step throws, which stays.
    QStringList TakeBack();
    void Clear();

    Listeners<> Changed;

 private:
    std::vector<UndoStep> steps_;
    Subscription ends_;
};
