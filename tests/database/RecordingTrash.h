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
        if (Refuses(path)) return false;
        Taken << path;
        return !Removes || QFile::remove(path);
    }
    // What is to come back lies beside its old place.
    QString PlaceFor(const QString& path) override {
        return Refuses(path) ? QString() : path + QStringLiteral(".thrown");
    }
    bool TakeTo(const QString& path, const QString& place) override {
        Taken << path;
        return QFile::rename(path, place);
    }
    bool Restore(const QString& place, const QString& path) override { return QFile::rename(place, path); }
    QStringList Taken;
    QString Refused;  // the end of a path that cannot be thrown away
    bool Removes = false;

 private:
    bool Refuses(const QString& path) const { return !Refused.isEmpty() && path.endsWith(Refused); }
};
