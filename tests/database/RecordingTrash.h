#pragma once

#include <QStringList>

#include "CommonRUKTools/Trash.h"

// Stands in for the system's recycle bin for its own lifetime: writes down what is thrown away and leaves it
// where it is.
class RecordingTrash : public Trash {
 public:
    RecordingTrash() { SetTrash(this); }
    ~RecordingTrash() override { SetTrash(nullptr); }
    bool Take(const QString& path) override {
        Taken << path;
        return true;
    }
    QStringList Taken;
};
