#include "app/desktop/Arrangement.h"

#include <QHash>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/SafeFile.h"

using namespace Qt::StringLiterals;

namespace {

const QByteArray kHead = "[Tunestead Desktop]";
const QByteArray kVersionLine = "Version=1";
constexpr std::int64_t kLargestFile = 1 << 20;

struct Row {
    const char* Name;
    QByteArray Arrangement::*Value;
};
constexpr Row kRows[] = {{"MainForm", &Arrangement::Placement},
                         {"MainFormState", &Arrangement::Docks},
                         {"SongListColumns", &Arrangement::Columns}};

[[noreturn]] void Refuse(const QString& path) {
    throw EStreamError(u"Diese Datei enthält keine Anordnung der Fenster, oder sie ist beschädigt: "_s +
                       path);
}

QByteArrayList Lines(const QString& path) {
    FileSource file(path);
    if (file.Size() > kLargestFile) Refuse(path);
    const auto bytes = file.ReadExactly(0, static_cast<std::size_t>(file.Size()));
    QByteArray text(reinterpret_cast<const char*>(bytes.data()), static_cast<qsizetype>(bytes.size()));
    return text.replace('\r', "").split('\n');
}

}  // namespace

Arrangement ReadArrangement(const QString& path) {
    const QByteArrayList lines = Lines(path);
    if (lines.size() < 2 || lines[0] != kHead || lines[1] != kVersionLine) Refuse(path);
    QHash<QByteArray, QByteArray> values;
    for (const QByteArray& line : lines) {
        const auto sign = line.indexOf('=');
        if (sign > 0) values.insert(line.first(sign), line.mid(sign + 1));
    }
    Arrangement arrangement;
    for (const Row& row : kRows) {
        const auto value =
            QByteArray::fromBase64Encoding(values.value(row.Name), QByteArray::AbortOnBase64DecodingErrors);
        if (!value || value.decoded.isEmpty()) Refuse(path);
        arrangement.*row.Value = value.decoded;
    }
    return arrangement;
}

void WriteArrangement(const QString& path, const Arrangement& arrangement) {
    QByteArray text = kHead + '\n' + kVersionLine + '\n';
    for (const Row& row : kRows)
        text += QByteArray(row.Name) + '=' + (arrangement.*row.Value).toBase64() + '\n';
    SafeFile file(path);
    file.Write(AsBytes(std::string_view(text.constData(), static_cast<std::size_t>(text.size()))));
    file.Commit();
}
