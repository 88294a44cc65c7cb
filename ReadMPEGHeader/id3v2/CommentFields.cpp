#include "ReadMPEGHeader/id3v2/CommentFields.h"

#include <QStringList>

using namespace Qt::StringLiterals;

namespace {

constexpr QStringView kPrivateCaption = u"Private Angaben:";
constexpr QStringView kUrlCaption = u"URL:";

// One line feed and one carriage return at most.
void RemoveLineEnd(QString& text) {
    if (text.endsWith(u'\n')) text.chop(1);
    if (text.endsWith(u'\r')) text.chop(1);
}

void RemoveLineStart(QString& text) {
    if (text.startsWith(u'\r')) text.remove(0, 1);
    if (text.startsWith(u'\n')) text.remove(0, 1);
}

qsizetype EndOfLine(QStringView text, qsizetype from) {
    while (from < text.size() && text[from] != u'\n' && text[from] != u'\r')
        ++from;
    return from;
}

CommentFields::Address ParseAddress(QStringView line) {
    CommentFields::Address address;
    const qsizetype close = line.startsWith(u'(') ? line.indexOf(u')') : -1;
    if (close > 0) {
        address.Description = line.sliced(1, close - 1).toString();
        address.Description.replace(u'[', u'(').replace(u']', u')');
        line = line.sliced(close + 1);
        while (!line.isEmpty() && line.front().isSpace())
            line = line.sliced(1);
    }
    address.Url = line.toString();
    return address;
}

}  // namespace

QString PrivateText(const QString& text) {
    return u"Private Angaben:\n"_s + text;
}

QString AddressText(const CommentFields::Address& address) {
    if (address.Description.isEmpty()) return u"URL:"_s + address.Url;
    // The description ends at the first ")", so it may hold none itself.
    QString description = address.Description;
    description.replace(u'(', u'[').replace(u')', u']');
    return u"URL:(%1) %2"_s.arg(description, address.Url);
}

QString CommentFields::Join() const {
    QStringList parts;
    if (!Comment.isEmpty()) parts += Comment;
    if (!Private.isEmpty()) parts += PrivateText(Private);
    for (const Address& address : Addresses)
        parts += AddressText(address);
    return parts.join(u'\n');
}

CommentFields CommentFields::Split(const QString& text) {
    CommentFields fields;
    QString rest = text;
    for (auto at = rest.indexOf(kUrlCaption); at >= 0; at = rest.indexOf(kUrlCaption, at)) {
        const qsizetype begin = at + kUrlCaption.size();
        const qsizetype end = EndOfLine(rest, begin);
        const Address address = ParseAddress(QStringView(rest).sliced(begin, end - begin));
        if (!address.Url.isEmpty()) fields.Addresses += address;
        QString before = rest.left(at);
        RemoveLineEnd(before);
        QString behind = rest.sliced(end);
        if (before.isEmpty()) RemoveLineStart(behind);
        at = before.size();
        rest = before + behind;
    }
    const qsizetype at = rest.indexOf(kPrivateCaption);
    fields.Comment = rest.left(at);
    if (at < 0) return fields;
    RemoveLineEnd(fields.Comment);
    fields.Private = rest.sliced(at + kPrivateCaption.size());
    RemoveLineStart(fields.Private);
    return fields;
}
