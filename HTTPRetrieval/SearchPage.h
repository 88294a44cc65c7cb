#pragma once

#include "HTTPRetrieval/SearchHit.h"

// The service that answers with a page: artist and title of every hit.

// `host` as "musik.example" or with a protocol before it; the protocol is HTTP otherwise. Blanks of the query
// become "+"; what an address cannot hold (beyond ASCII, controls, "#") is percent-encoded as UTF-8, and
// nothing else is.
QString SearchPageUrl(const QString& host, const QString& query);

// Reads the hits of a page from its beginning to its end. Artist and title may lie within each other where
// links are not closed; a link of more than 500 characters is none, so that what a page can cost grows with
// its length only.
class SearchPage {
 public:
    explicit SearchPage(QString page) : page_(std::move(page)) {}

    static constexpr qsizetype kLongestLink = 500;

    std::optional<SearchHit> Next();

 private:
    bool Pass(QStringView mark);
    std::optional<QString> TextOfLink() const;

    QString page_;
    qsizetype place_ = 0;  // what lies before it has been read
};
