#pragma once

#include <QByteArray>
#include <QObject>
#include <QStringList>
#include <QThreadPool>
#include <atomic>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

// What the tags of some files hold and their songs' records do not.
struct FileTags {
    std::vector<std::optional<int>> TrackTotals{};  // of each file, in their order; 0 where the tag has none
    std::optional<QByteArray> Cover{};              // of an image file; that of the first file
    bool CoversDiffer = false;
    QString Failure{};  // why a file could not be read; of the first such file
};

// More files are not looked through for an editor that shows what they have in common.
inline constexpr std::size_t kMostFilesRead = 200;

// Stops before the next file once `stop` is set.
FileTags ReadFileTags(const QStringList& paths, const std::atomic<bool>& stop);

// Reads the tags of files in a thread: a disk that sleeps takes its time.
class FileTagsReader : public QObject {
 public:
    explicit FileTagsReader(QObject* parent = nullptr);
    ~FileTagsReader() override;

    // What is being read for somebody who asked before is given up.
    void Read(const QStringList& paths);
    void Stop();
    bool Reading() const { return reading_; }
    // In the thread of this object.
    std::function<void(const FileTags&)> OnRead;

 private:
    std::shared_ptr<std::atomic<bool>> stop_;  // of the request that counts
    bool reading_ = false;
    QThreadPool thread_;
};
