#include "app/desktop/DesktopEntry.h"

using namespace Qt::StringLiterals;

namespace {

// Marks the entries that the program has made itself.
const QByteArray kProgramKey = "X-Tunestead-Program=";

// The general escape of a value.
QString Escaped(QString value) {
    return value.replace(u'\\', u"\\\\"_s)
        .replace(u'\n', u"\\n"_s)
        .replace(u'\t', u"\\t"_s)
        .replace(u'\r', u"\\r"_s);
}

QString Unescaped(const QString& value) {
    QString text;
    for (qsizetype i = 0; i < value.size(); ++i) {
        if (value[i] != u'\\' || i + 1 == value.size()) {
            text += value[i];
            continue;
        }
        const QChar letter = value[++i];
        text += letter == u'n' ? u'\n' : letter == u't' ? u'\t' : letter == u'r' ? u'\r' : letter;
    }
    return text;
}

// A program's name as a word of a command line: quoted as for a shell, and "%" begins a field.
QString Quoted(const QString& program) {
    QString word;
    for (const QChar letter : program) {
        if (u"\"`$\\"_s.contains(letter)) word += u'\\';
        word += letter;
        if (letter == u'%') word += letter;
    }
    return u'"' + word + u'"';
}

}  // namespace

QByteArray EntryFor(const QByteArray& packed, const QString& program) {
    QByteArray entry;
    for (const QByteArray& line : packed.trimmed().split('\n')) {
        if (line.startsWith("Exec="))
            entry += "Exec=" + Escaped(Quoted(program)).toUtf8() + " %F\n" + kProgramKey +
                     Escaped(program).toUtf8() + '\n';
        else
            entry += line + '\n';
    }
    return entry;
}

QString InstalledProgram(const QByteArray& entry) {
    for (const QByteArray& line : entry.split('\n'))
        if (line.startsWith(kProgramKey)) return Unescaped(QString::fromUtf8(line.mid(kProgramKey.size())));
    return {};
}

QByteArray WithoutDefaults(const QByteArray& list, const QString& entryName, const QStringList& types) {
    QByteArrayList kept;
    for (const QByteArray& line : list.split('\n')) {
        const auto sign = line.indexOf('=');
        const bool isOurs = sign >= 0 && types.contains(QString::fromUtf8(line.first(sign).trimmed()));
        QByteArrayList entries = isOurs ? line.mid(sign + 1).trimmed().split(';') : QByteArrayList();
        if (entries.removeAll(entryName.toUtf8()) == 0) {
            kept << line;
            continue;
        }
        entries.removeAll(QByteArray());
        if (!entries.isEmpty()) kept << line.first(sign + 1) + entries.join(';') + ';';
    }
    return kept.join('\n');
}
