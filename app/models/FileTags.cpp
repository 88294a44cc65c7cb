#include "app/models/FileTags.h"

#include "CommonRUKTools/BufferedSource.h"
#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/TagWriting.h"
#include "ReadMPEGHeader/id3v2/CoverArt.h"

namespace {

struct OneFile {
    std::optional<int> TrackTotal{};
    std::optional<QByteArray> Cover{};
    QString Failure{};
};

OneFile Read(const QString& path) {
    OneFile tags;
    try {
        FileSource file(path);
        BufferedSource stream(file);
        tags.TrackTotal = ReadTrackTotal(stream).value_or(0);
        tags.Cover = ReadCoverArt(stream);
    } catch (const EStreamError& error) {
        tags.Failure = error.Message();
    }
    return tags;
}

}  // namespace

FileTags ReadFileTags(const QStringList& paths, const std::atomic<bool>& stop) {
    FileTags tags;
    for (const QString& path : paths) {
        if (stop) break;
        const OneFile file = Read(path);
        if (tags.TrackTotals.empty())
            tags.Cover = file.Cover;
        else
            tags.CoversDiffer |= file.Cover != tags.Cover;
        tags.TrackTotals.push_back(file.TrackTotal);
        if (tags.Failure.isEmpty()) tags.Failure = file.Failure;
    }
    return tags;
}

FileTagsReader::FileTagsReader(QObject* parent) : QObject(parent) {
    thread_.setMaxThreadCount(1);
}

FileTagsReader::~FileTagsReader() {
    Stop();
    thread_.waitForDone();
}

void FileTagsReader::Stop() {
    if (stop_) *stop_ = true;
    stop_.reset();
    reading_ = false;
}

void FileTagsReader::Read(const QStringList& paths) {
    Stop();
    reading_ = true;
    stop_ = std::make_shared<std::atomic<bool>>(false);
    thread_.start([this, paths, stop = stop_] {
        auto tags = ReadFileTags(paths, *stop);
        if (*stop) return;
        const auto hand = [this, stop, tags = std::move(tags)] {
            if (*stop) return;
            reading_ = false;
            if (OnRead) OnRead(tags);
        };
        QMetaObject::invokeMethod(this, hand, Qt::QueuedConnection);
    });
}
