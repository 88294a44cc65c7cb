#pragma once

#include <QList>
#include <QString>

// A record's comment shows three kinds of frames as one text: the comment itself, then the private text and
// the addresses, each behind its caption. The frames are told apart again when the tag is written.
struct CommentFields {
    struct Address {
        QString Description;  // may be empty
        QString Url;
    };

    QString Comment;
    QString Private;
    QList<Address> Addresses;

    // "Comment", "Private Angaben:" with its text on the next line, "URL:" lines; whatever is empty is left
    // out.
    QString Join() const;
};

// "Private Angaben:", a line break and the text.
QString PrivateText(const QString& text);
// "URL:" and the address, which a description in parentheses precedes.
QString AddressText(const CommentFields::Address& address);
