#include "ReadMPEGHeader/id3v2/CommentFields.h"

#include <QStringList>

using namespace Qt::StringLiterals;

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
