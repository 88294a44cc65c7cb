#pragma once

#include <array>
#include <optional>
#include <string_view>

// What a record holds of a tag, in the order in which the frames are written.
enum class TagField {
    Title,
    Artist,
    Album,
    Year,
    Comment,
    Private,  // the private part of the comment
    Address,  // the addresses in it
    FileType,
    Length,
    Genre,
    Track,
    PlayCount,
    Own,  // "XRUK"
};

inline constexpr std::array kTagFields = {
    TagField::Title,   TagField::Artist,    TagField::Album,    TagField::Year,   TagField::Comment,
    TagField::Private, TagField::Address,   TagField::FileType, TagField::Length, TagField::Genre,
    TagField::Track,   TagField::PlayCount, TagField::Own,
};

// The id of the frames that hold a field.
std::string_view FrameIdOf(TagField field);
// The field that frames of an id may hold.
std::optional<TagField> FieldOfFrame(std::string_view id);
