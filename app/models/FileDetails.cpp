#include "app/models/FileDetails.h"

#include <QDateTime>
#include <QFileInfo>
#include <QLocale>

#include "CommonRUKTools/BufferedSource.h"
#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/id3v2/CoverArt.h"
#include "app/models/CoverImage.h"

using namespace Qt::StringLiterals;

namespace {

// A tag may hold lyrics of any length and thousands of frames; nobody reads on.
constexpr qsizetype kLongestText = 4000;
constexpr std::size_t kMostFrames = 1000;

QString FrameText(const FrameReport& frame) {
    QString text = frame.Text.left(kLongestText);
    if (frame.Text.size() > kLongestText) text += u'…';
    if (!frame.Number) return text;
    QString number = QString::number(*frame.Number);
    if (text.isEmpty() || text == number) return number;
    return text + u" ["_s + number + u']';
}

QString SizeText(qint64 bytes) {
    const QLocale german(QLocale::German);
    QString exact = german.toString(bytes) + u" Bytes"_s;
    if (bytes < 1024) return exact;
    return german.formattedDataSize(bytes, 2, QLocale::DataSizeTraditionalFormat) + u" ("_s + exact + u')';
}

std::vector<PropertyRow> FileProperties(const QString& path) {
    const QFileInfo file(path);
    if (!file.exists()) return {};
    return {{u"Größe"_s, SizeText(file.size())},
            {u"Änderungsdatum"_s, file.lastModified().toString(u"dd.MM.yyyy hh:mm:ss"_s)}};
}

QImage CoverOf(const QString& path) {
    FileSource file(path);
    BufferedSource stream(file);
    const auto bytes = ReadCoverArt(stream);
    return bytes ? DecodeCover(*bytes) : QImage();
}

}  // namespace

FileDetails ReadFileDetails(const QString& path, ReadOptions options) {
    FileDetails details;
    details.File = FileProperties(path);
    options.OnFrame = [&details](const FrameReport& frame) {
        if (details.Frames.size() < kMostFrames) details.Frames.push_back({frame.Id, FrameText(frame)});
    };
    try {
        details.Error = ReadSong(path, options).Failure();
        if (details.Error.isEmpty()) details.Cover = CoverOf(path);
    } catch (const EStreamError& error) {
        details.Error = error.Message();
    }
    return details;
}
