#include "ReadMPEGHeader/FileTypeText.h"

#include <QStringView>
#include <algorithm>
#include <array>

namespace {

struct FileTypeRow {
    QStringView Type;
    QStringView Format;
};

constexpr std::array<FileTypeRow, 7> kFileTypes = {{
    {u"/1", u"MPEG 1/2 Layer I"},
    {u"/2", u"MPEG 1/2 Layer II"},
    {u"/3", u"MPEG 1/2 Layer III"},
    {u"/2.5", u"MPEG 2.5 Layer ???"},
    {u"/AAC", u"Advanced Audio Compression"},
    {u"VQF", u"Vector Quantization (VQF)"},
    {u"PCM", u"Pulse Code Modulated (PCM)"},
}};

}  // namespace

QString FormatFromFileType(const QString& fileType) {
    QStringView type = fileType;
    if (type.startsWith(u"MPG/")) type = type.mid(3);
    const auto row = std::ranges::find(kFileTypes, type, &FileTypeRow::Type);
    return row == kFileTypes.end() ? fileType : row->Format.toString();
}

QString FileTypeFromFormat(const QString& format) {
    const auto row = std::ranges::find(kFileTypes, QStringView(format), &FileTypeRow::Format);
    return row == kFileTypes.end() ? format : row->Type.toString();
}
