#include "app/views/ColumnLayout.h"

#include <QDataStream>
#include <QHeaderView>
#include <QIODevice>
#include <algorithm>
#include <vector>

#include "app/models/SongColumns.h"

namespace {

constexpr quint32 kMark = 0x54534331;  // "TSC1"
constexpr int kMaxWidth = 10'000;      // pixels
constexpr int kMinWidth = 8;

struct Column {
    qint32 Id;
    qint32 Width;
    bool Hidden;
};

// Hidden columns have no size of their own in a header: showing them for a moment tells it.
int WidthOf(QHeaderView& header, int section) {
    if (!header.isSectionHidden(section)) return header.sectionSize(section);
    const QSignalBlocker silent(header);
    header.showSection(section);
    const int width = header.sectionSize(section);
    header.hideSection(section);
    return width;
}

bool IsPossible(const Column& column, const std::vector<Column>& before) {
    const auto sameId = [&column](const Column& other) { return other.Id == column.Id; };
    return column.Id >= 0 && column.Id < static_cast<int>(SongColumns().size()) &&
           column.Width >= kMinWidth && column.Width <= kMaxWidth && std::ranges::none_of(before, sameId);
}

// Empty when the bytes are no layout.
std::vector<Column> Read(const QByteArray& saved) {
    QDataStream stream(saved);
    stream.setVersion(QDataStream::Qt_6_0);
    quint32 mark = 0;
    stream >> mark;
    if (mark != kMark) return {};
    std::vector<Column> columns;
    while (!stream.atEnd()) {
        Column column{};
        stream >> column.Id >> column.Width >> column.Hidden;
        if (stream.status() != QDataStream::Ok || !IsPossible(column, columns)) return {};
        columns.push_back(column);
    }
    return columns;
}

}  // namespace

QByteArray SaveColumnLayout(QHeaderView& header) {
    QByteArray saved;
    QDataStream stream(&saved, QIODevice::WriteOnly);
    stream.setVersion(QDataStream::Qt_6_0);
    stream << kMark;
    for (int visual = 0; visual < header.count(); ++visual) {
        const int section = header.logicalIndex(visual);
        stream << qint32(section) << qint32(WidthOf(header, section)) << header.isSectionHidden(section);
    }
    return saved;
}

bool RestoreColumnLayout(QHeaderView& header, const QByteArray& saved) {
    const std::vector<Column> columns = Read(saved);
    if (columns.empty()) return false;
    int visual = 0;
    for (const auto& [id, width, hidden] : columns) {
        const bool isTitle = id == static_cast<int>(SongFieldId::Title);
        header.showSection(id);
        header.moveSection(header.visualIndex(id), visual++);
        header.resizeSection(id, width);
        header.setSectionHidden(id, hidden && !isTitle);
    }
    return true;
}
