#include "ReadMPEGHeader/id3v2/ID3v2Frames.h"

#include <gtest/gtest.h>

#include "ReadMPEGHeader/id3v2/MediaType.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Id3v2Builder.h"

using namespace Qt::StringLiterals;
using namespace std::string_literals;

namespace {

struct FrameCase {
    std::string Id;
    std::string Body;
    QString Text;
    std::optional<qint64> Number;
};

class FrameTexts : public testing::TestWithParam<FrameCase> {};

const FrameCase kCases[] = {
    {"TIT2", "\0Titel"s, u"Titel"_s, {}},
    {"TRCK", "\0003/12"s, u"3/12"_s, 3},
    {"TLEN", "\000245000"s, u"245000"_s, 245000},
    {"TCON", "\0(17)Rock"s, u"(17)Rock"_s, 17},
    {"TFLT", "\0MPG/2.5"s, u"MPEG 2.5 Layer ???"_s, {}},
    {"TFLT", "\0MPG"s, u"MPG"_s, {}},
    {"TMED", "\0(MC/4/II)"s, u"Kassette, 4,75 cm/s, Type II (Chrome)"_s, {}},
    {"TXXX", "\0Stimmung\0gut"s, u"Stimmung: gut"_s, {}},
    {"WXXX", "\0\0http://a.de"s, u"URL:http://a.de"_s, {}},
    {"PRIV", "Firma\0\1\2"s, u"Private Angaben:\nFirma"_s, {}},
    {"PCNT", "\0\0\0\x0C"s, u"12 mal gespielt"_s, 12},
    {"COMM", "\0deu\0Gut"s, u"(deu) Gut"_s, {}},
    {"USLT", "\0engStrophe\0La"s, u"(eng) Strophe: La"_s, {}},
    {"USER", "\0deuNur privat"s, u"(deu) Nur privat"_s, {}},
    {"SYLT",
     "\0deu\2\1Text\0Das\0\0\0\0\1ist\0\0\0\0\2\nalles\0\0\0\0\3"s,
     u"(deu) Text: Das ist\nalles"_s,
     {}},
    {"UFID", "http://a.de\0id"s, u"14 Byte bin"_s, 14},
    {"ETCO", "\2\1\0\0\0\1"s, u"Vorhanden (1 Eintrag)"_s, 1},
    {"ETCO", "\2\1\0\0\0\1\2\0\0\0\2"s, u"Vorhanden (2 Einträge)"_s, 2},
    {"MLLT", "123456", u"Vorhanden (6 Byte)"_s, 6},
    {"RVAD", "\1\x10\1\0\0\2"s, u"Lautstärke links -2, rechts +256 (16 Bit)"_s, {}},
    {"RVAD", "\1\xFF\1"s, u"Vorhanden (3 Byte)"_s, 3},
    {"EQUA", "\x10\x80\1\0\1\x80\2\0\2"s, u"Vorhanden (2 Einträge)"_s, 2},
    {"RVRB", "\0\x64\1\0\0\0\0\0\0\0\0\0"s, u"Hall links 100 ms, rechts 256 ms"_s, {}},
    {"APIC", "\0image/png\0\1Logo\0data"s, u"32x32 Icon (PNG), image/png, Logo"_s, 4},
    {"APIC", "\0\0\x14\0"s, u"Firmenzeichen des Herausgebers/Studios"_s, 0},
    {"APIC", "\0\0\x15\0"s, u"Unbekannt (0x15 != ox00-ox14 )"_s, 0},
    {"GEOB", "\0text/plain\0a.txt\0Notiz\0data"s, u"a.txt, Notiz, text/plain, 4 Byte"_s, 4},
    {"POPM", "a@b.de\0\x80\0\0\0\7"s, u"a@b.de, Wertung 128 von 255, 7 mal gespielt"_s, 7},
    {"LINK", "TIT2http://a.de\0Nr. 1"s, u"TIT2 http://a.de ID:Nr. 1"_s, {}},
    {"POSS", "\2\0\0\1\0"s, u"256 Millisekunden"_s, 256},
    {"POSS", "\7\5", u"5 unbek. Einheiten"_s, 5},
    {"OWNE", "\0EUR9.99\00020020131Laden"s, u"Bezahlter Preis: EUR9.99, Datum: 31.01.2002, Laden"_s, {}},
    {"COMR",
     "\0EUR5\00020031224http://a.de\0\3Laden\0Lied\0"s,
     u"Preis: EUR5, gültig bis 24.12.2003, als: Datei aus dem Internet, Laden, Lied, http://a.de"_s,
     {}},
    {"XXXX", "1234", u"4 Byte"_s, 4},
};

}  // namespace

TEST_P(FrameTexts, AreTheSameInBothProfiles) {
    const FrameCase& expected = GetParam();
    const auto bytes = Id3v2Builder(3).Frame(expected.Id, expected.Body).Build();
    for (Id3v2ReadFunction* read : {&ReadID3v2, &ReadID3v2Modern}) {
        const auto outcome = ReadWith(*read, bytes);
        ASSERT_EQ(outcome.Reports.size(), 1u);
        EXPECT_EQ(outcome.Reports[0].Id, QString::fromStdString(expected.Id));
        EXPECT_EQ(outcome.Reports[0].Text, expected.Text);
        EXPECT_EQ(outcome.Reports[0].Number, expected.Number);
        // A body that ends anywhere is read as far as it goes.
        for (std::size_t size = 0; size < expected.Body.size(); ++size) {
            const auto cut = Id3v2Builder(3).Frame(expected.Id, expected.Body.substr(0, size)).Build();
            EXPECT_EQ(ReadWith(*read, cut).Reports.size(), 1u) << size;
        }
    }
}

INSTANTIATE_TEST_SUITE_P(ID3v2Frames, FrameTexts, testing::ValuesIn(kCases),
                         [](const auto& frame) { return frame.param.Id + std::to_string(frame.index); });

TEST(MediaType, CodesBecomeTexts) {
    const std::pair<QString, QString> cases[] = {
        {u"(DAT/5)"_s, u"DAT, Mode 5, 44.1 kHz/16 Bit, Linear"_s},
        {u"(VID/PAL/VHS)(RAD/FM)"_s, u"Video, PAL, VHS, Radio, FM"_s},
        {u"(REE/19/IV) vom Dachboden"_s, u"Reel, 19 cm/s, Type IV (Metal), vom Dachboden"_s},
        {u"(TEL/I"_s, u"(TEL/I"_s},
        {u"(XYZ/9)"_s, u"XYZ/9"_s},
        {u"((eigen)"_s, u"(eigen)"_s},
        {u"()/"_s, u", /"_s},
        {QString(), QString()},
    };
    for (const auto& [codes, text] : cases)
        EXPECT_EQ(MediaTypeText(codes), text);
}
