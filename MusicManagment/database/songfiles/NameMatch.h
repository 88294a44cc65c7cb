#pragma once

#include <QString>
#include <optional>
#include <vector>

#include "MusicManagment/database/SongFields.h"

// Reads what the names of song files say by a pattern such as "%ARTIST% - %TITLE%": the opposite of
// BuildNameFromPattern.

// A field, and what a user would enter there.
struct NamedField {
    SongFieldId Field;
    QString Text;
};

// What a path says of its song.
struct NameReading {
    std::vector<NamedField> Fields{};
    QString Problem{};  // why the path says nothing, for the user; empty where it fits
};

// A pattern, taken apart once for many paths.
//
// The name without its extension has to fit as a whole; separators ('/' or '\') in the pattern are folders,
// the last ones of the path. Text has to stand there as it is, in NFC. A place-holder takes as little as it
// can, so the first separator that fits divides a name: "A - B - C" is the artist "A" and the title "B - C".
// It takes more where its field could not hold the less: a year is four digits, a track a number, a genre one
// of the list, also as file names spell it ("Rock-Pop"). One that stands there twice means the same twice.
// Place-holders of technical data are passed over.
//
// Blanks around a value are no part of it. A value that says nothing (empty, track 0, year 0000, an unknown
// genre) is none: the field stays what it is.
class NameMatcher {
 public:
    explicit NameMatcher(const QString& pattern);

    // What is wrong with the pattern, for the user; empty when it can be used.
    const QString& Fault() const { return fault_; }
    // The fields that the pattern can fill, each once, in its order.
    std::vector<SongFieldId> Fields() const;
    // How many folders of a path it looks at.
    qsizetype Folders() const { return folders_; }

    // Only without a fault.
    NameReading Read(const QString& path) const;

 private:
    class Walk;

    struct Placeholder {
        QString Name;
        std::optional<SongFieldId> Field;  // nothing for technical data
        bool Recurs = false;
    };
    // A text, or the place-holder of that number.
    struct Part {
        QString Text{};
        std::optional<std::size_t> Number{};
    };

    void Divide(const QString& pattern);
    void AddPlaceholder(const QString& name);
    void AddText(QChar character);
    QString FaultOfParts() const;
    QString TextOf(const QString& path) const;
    QString ProblemOf(const QString& text) const;

    std::vector<Placeholder> placeholders_;  // each once
    std::vector<Part> parts_;
    qsizetype folders_ = 0;
    QString fault_;
};

// The record with what its name says.
TID3Tag WithNamedFields(TID3Tag record, const NameReading& reading);
