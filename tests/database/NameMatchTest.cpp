#include "MusicManagment/database/songfiles/NameMatch.h"

#include <gtest/gtest.h>

#include <array>

#include "MusicManagment/database/songfiles/NamePattern.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

const QString kNoFit = u"Passt nicht zum Muster"_s;

QString Said(const NameMatcher& matcher, const QString& path) {
    if (!matcher.Fault().isEmpty()) return matcher.Fault();
    const NameReading reading = matcher.Read(path);
    QStringList fields;
    for (const NamedField& named : reading.Fields)
        fields << QLatin1StringView(FieldOf(named.Field).FormName) + u'=' + named.Text;
    return reading.Problem.isEmpty() ? fields.join(u", "_s) : reading.Problem;
}

}  // namespace

TEST(NameMatch, NamesAreReadByPatterns) {
    // Pattern, path, and "field=text" for each field, or the problem.
    const std::array<QString, 3> cases[] = {
        // The first separator divides, blanks around values go, text is itself.
        {u"%ARTIST% - %TITLE%"_s, u"/m/A - B - C.mp3"_s, u"artist=A, title=B - C"_s},
        {u"Live %TITLE%"_s, u"/m/live Eins.mp3"_s, kNoFit},
        {u"%ARTIST%_-_%TITLE%"_s, u"/m/A_B_-_C_D.mp3"_s, u"artist=A_B, title=C_D"_s},
        {u"(%YEAR%) %TITLE% [100%]"_s, u"/m/(1999) T [100%].mp3"_s, u"year=1999, title=T"_s},
        // A field that could not hold it takes more.
        {u"%ARTIST% %YEAR% %TITLE%"_s, u"/m/A B 1999 T 2000.mp3"_s, u"artist=A B, year=1999, title=T 2000"_s},
        {u"%MAINGENRE%-%ARTIST%"_s, u"/m/rock-pop-X.mp3"_s, u"mainGenre=Rock/Pop, artist=X"_s},
        {u"%TRACKNR% %TITLE%"_s, u"/m/007 T.mp3"_s, u"track=7, title=T"_s},
        // What says nothing is not told.
        {u"%TRACKNR%-%YEAR%-%ID3GENRE%-%MAINGENRE%-%TITLE%"_s, u"/m/00-0000-Undefiniert-Unbekannt- T.mp3"_s,
         u"title=T"_s},
        {u"%ARTIST% - %TITLE%"_s, u"/m/ - T.mp3"_s, u"title=T"_s},
        {u"%TITLE% (%KBPS%, %LENGTHF%)"_s, u"/m/T (192, 3-45).mp3"_s, u"title=T"_s},
        // Folders are the last ones of the path.
        {u"%ARTIST%\\%ALBUM%/%TRACKNR%. %TITLE%"_s, u"/m/x/A/B/1. T.mp3"_s,
         u"artist=A, album=B, track=1, title=T"_s},
        {u"/%ARTIST%/%TITLE%"_s, u":00000001:\\A\\T.mp3"_s, u"artist=A, title=T"_s},
        {u"%ARTIST% - %TITLE%"_s, u"/m/A - B/T.mp3"_s, kNoFit},
        {u"%ALBUM%/%ARTIST%/%TITLE%"_s, u"A/T.mp3"_s, kNoFit},
        // Twice is twice the same, and decides where a name is divided.
        {u"%ARTIST%/%ARTIST% - %TITLE%"_s, u"/m/A - B/A - B - C.mp3"_s, u"artist=A - B, title=C"_s},
        {u"%TITLE%.%TITLE% %ALBUM%"_s, u"a.b.a.b x.mp3"_s, u"title=a.b, album=x"_s},
        {u"%ARTIST%/%ARTIST% - %TITLE%"_s, u"/m/A/B - C.mp3"_s,
         u"Der Name sagt zu demselben Platzhalter Verschiedenes"_s},
        // Letters and marks of their own are the letters that the pattern has.
        {u"Grüße %TITLE%"_s, u"/m/Gru\u0308ße Mu\u0308ll.mp3"_s, u"title=Müll"_s},
        // What a field cannot hold.
        {u"%YEAR% %TITLE%"_s, u"/m/LIVE T.mp3"_s, u"Jahr erwartet vier Ziffern, nicht „LIVE“"_s},
        {u"%TRACKNR% %TITLE%"_s, u"/m/256 T.mp3"_s, u"Track erwartet eine Zahl von 0 bis 255, nicht „256“"_s},
        // Patterns that no name can be read by.
        {u"%ARTIST%%TITLE%"_s, u"x"_s,
         u"Zwischen %ARTIST% und %TITLE% muss ein Text stehen, sonst ist nicht klar, wo sich der Name teilt."_s},
        {u"%KBPS%"_s, u"x"_s, u"Das Muster enthält keinen Platzhalter für ein Feld des Tags."_s},
    };
    for (const auto& [pattern, path, expected] : cases)
        EXPECT_EQ(Said(NameMatcher(pattern), path), expected) << pattern.toStdString();
    // However many ways there are to divide it.
    const QString words = u"0 "_s.repeated(60);
    EXPECT_EQ(Said(NameMatcher(NamePatternPlaceholders().join(u' ') + u'!'), words), kNoFit);
    EXPECT_EQ(Said(NameMatcher(u"%ALBUM% %ARTIST% %TITLE% %COMMENT% "_s.repeated(2) + u'!'), words),
              u"Der Name lässt sich auf zu viele Arten teilen"_s);
}

TEST(NameMatch, WhatANameGotFromARecordComesBack) {
    TID3Tag song;
    song.Artist = u"Ärzte"_s;
    song.Title = u"Nie - Nie"_s;
    song.Year = u"1993"_s;
    song.Genre = 81;  // Folk/Rock
    song.Track = 4;
    song.MainGenre = 1;
    const QString pattern = u"%TRACKNR%_%MAINGENRE% %ID3GENRE% %YEAR% %ARTIST% - %TITLE%"_s;
    const QString path = BuildNameFromPattern(pattern, u"/m/x.mp3"_s, song);
    EXPECT_EQ(WithNamedFields(TID3Tag(), NameMatcher(pattern).Read(path)), song) << path.toStdString();
}
