#include "MusicManagment/conversion/PartialFile.h"

#include <QDateTime>
#include <QDir>
#include <QFile>
#include <QRandomGenerator>
#include <QRegularExpression>

#include "CommonRUKTools/FileChange.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kBuffer = std::size_t{1} << 18;
constexpr int kAbandonedAfter = 60 * 60;  // seconds

const QString kBegin = u".tunestead-convert-"_s;
const QString kEnd = u".tmp"_s;

}  // namespace

PartialFile::PartialFile(const QString& target) : target_(target) {
    const QString folder = FolderOfFile(target);
    if (!QDir().mkpath(folder)) throw EStreamError(u"Kann den Ordner nicht anlegen: "_s + folder);
    const QString number = QString::number(QRandomGenerator::system()->generate64(), 36);
    path_ = folder + u'/' + kBegin + number + kEnd;
}

PartialFile::~PartialFile() {
    if (!hasName_) QFile::remove(path_);
}

void PartialFile::TakeName() {
    FlushFiles({path_});
    MoveFile(path_, target_);
    hasName_ = true;
}

QString NamedAsTarget(QString message, const QString& target) {
    static const QRegularExpression kName(QRegularExpression::escape(kBegin) + u"[0-9a-z]+"_s +
                                          QRegularExpression::escape(kEnd));
    return message.replace(kName, target.mid(target.lastIndexOf(u'/') + 1));
}

void SweepPartialFiles(const QString& folder) {
    const QDateTime oldest = QDateTime::currentDateTimeUtc().addSecs(-kAbandonedAfter);
    const QDir::Filters files = QDir::Files | QDir::Hidden | QDir::NoSymLinks;
    for (const QFileInfo& file : QDir(folder).entryInfoList({kBegin + u'*' + kEnd}, files))
        if (file.lastModified() < oldest) QFile::remove(file.filePath());
}

void FileWriter::Append(ByteSpan bytes) {
    buffer_.insert(buffer_.end(), bytes.begin(), bytes.end());
    if (buffer_.size() >= kBuffer) Empty();
}

void FileWriter::Overwrite(std::int64_t position, ByteSpan bytes) {
    Empty();
    file_.Write(position, bytes);
}

void FileWriter::Empty() {
    file_.Write(written_, buffer_);
    written_ += static_cast<std::int64_t>(buffer_.size());
    buffer_.clear();
}
