#pragma once

#include <QFile>
#include <QStringList>

#include "CommonRUKTools/Trash.h"

// Stands in for the system's recycle bin for its own lifetime: writes down what is thrown away and leaves it
// where it is, unless it is to go.
class RecordingTrash : public Trash {
 public:
    RecordingTrash() { SetTrash(this); }
    ~RecordingTrash() override { SetTrash(nullptr); }
    bool Take(const QString& path) override {
        if (!Refused.isEmpty() && path.endsWith(Refused)) return false;
        Taken << path;
        return !Removes || QFile::remove(path);
    }
    QStringList Taken;
    QString Refused;  // the end of a path that cannot be thrown away
    bool Removes = false;
};
