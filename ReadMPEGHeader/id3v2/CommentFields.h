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
    // Takes a comment apart, wherever the captions stand: the rest of each line behind "URL:" is an address
    // (a description in parentheses before it), what then stands behind "Private Angaben:" is the private
    // text, what stands before it the comment. The line breaks that Join puts between them belong to none.
    static CommentFields Split(const QString& text);
};

// "Private Angaben:", a line break and the text.
QString PrivateText(const QString& text);
// "URL:" and the address, which a description in parentheses precedes.
QString AddressText(const CommentFields::Address& address);
