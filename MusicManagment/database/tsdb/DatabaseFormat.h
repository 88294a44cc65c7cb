#pragma once

#include <QStringView>
#include <array>
#include <cstddef>
#include <string_view>

#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/ID3Tag.h"

// The layout of the database file, for its reader and its writer. docs/formats.md describes the whole.
namespace DatabaseFormat {

inline constexpr std::string_view kMagic = "TSDB By RUK";
inline constexpr std::size_t kCountOffset = 13;  // magic and two version bytes lie before the song count
inline constexpr std::size_t kHeaderSize = 17;

// Major version times 256 plus minor version.
inline constexpr int kVersion10 = 0x0100;
inline constexpr int kVersion11 = 0x0101;
inline constexpr int kVersion12 = 0x0102;  // the first with group lists
inline constexpr int kVersion20 = 0x0200;

// Sizes of the text blocks that are padded with zeros; a full block has no terminator.
inline constexpr std::size_t kFolderBlock = 260;

struct GroupList {
    TOVType Type;
    std::size_t Block;
};
inline constexpr std::size_t kCaptionBlock = 512;
inline constexpr std::size_t kBucketBlock = 128;
inline constexpr std::array<GroupList, 4> kGroupLists = {
    {{ovArtist, kCaptionBlock}, {ovAlbum, kCaptionBlock}, {ovYear, kBucketBlock}, {ovLength, kBucketBlock}}};

// The texts behind the fixed part of a song record, each with a 32-bit length before it.
struct SongText {
    QString TID3Tag::*Field;
    QStringView Word;  // its name in messages
    bool Repeats;      // many songs have the same one
    // Bytes of it that its group's caption has room for; 0 where it makes no group.
    std::size_t CaptionRoom = 0;
};
inline constexpr std::array<SongText, 6> kSongTexts = {{{&TID3Tag::FileName, u"FileName", false},
                                                        {&TID3Tag::Title, u"Title", false},
                                                        {&TID3Tag::Artist, u"Artist", true, kCaptionBlock},
                                                        {&TID3Tag::Album, u"Album", true, kCaptionBlock},
                                                        {&TID3Tag::Comment, u"Kommentar", true},
                                                        {&TID3Tag::MPEGLayer, u"MPEGLayer", true}}};
inline constexpr std::size_t kLongestText = 65535;

// A progress point comes before every song whose number is a multiple of this.
inline constexpr int kSongsPerPoint = 50;
// Between rows of the lists the interface only gets its turn.
inline constexpr int kRowsPerTurn = 1024;

}  // namespace DatabaseFormat
