#pragma once

#include <QString>
#include <QTemporaryDir>
#include <functional>
#include <memory>

#include "app/models/FileTags.h"

// The cover of a song as a file that other programs can show; it goes with this object.
class CoverFile {
 public:
    CoverFile();

    // The song whose cover it is to be; empty for none. It is read in a thread.
    void Show(const QString& song);
    // The address of the picture; empty while there is none.
    const QString& Url() const { return url_; }
    // The address is there now.
    std::function<void()> OnFound;

 private:
    void Take(const QByteArray& picture);

    QString song_;
    QString url_;
    QString path_;   // of the picture
    int count_ = 0;  // of pictures: a program that keeps them goes by their names
    std::unique_ptr<QTemporaryDir> folder_;
    FileTagsReader reader_;
};
