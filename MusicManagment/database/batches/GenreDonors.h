#pragma once

#include <QHash>
#include <QString>
#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "MusicManagment/database/MusicManagment.h"

// The songs whose main genre others may take, one for each artist: the first of the collection's order that
// has a main genre. It is made once, so that a batch that changes the collection meanwhile goes on asking
// what it began with.
class GenreDonors {
 public:
    struct Donor {
        QString Artist;  // as it is spelt there
        quint8 MainGenre = 0;
    };
    struct Likeness {
        Donor From;
        int Percent = 0;  // of the similarity, without its fraction
    };

    explicit GenreDonors(const TMusicDatabase& database);

    // The one whose artist is the same but for upper and lower case; nullptr when there is none.
    const Donor* OfArtist(const QString& artist) const;
    // The one whose artist is most alike, at least by 60 percent; of several the first.
    std::optional<Likeness> MostAlike(const QString& artist) const;

 private:
    struct Key {
        std::u32string Text;
        // How often each letter occurs, different ones being thrown together: gives a bound of the distance
        // without a look at the texts.
        std::array<std::uint8_t, 32> Letters{};
        std::size_t Place = 0;  // in donors_
    };
    static Key MakeKey(const QString& artist, std::size_t place);

    std::vector<Donor> donors_;  // in the order of the collection
    QHash<QString, std::size_t> byFoldedArtist_;
    std::vector<Key> keys_;  // by length
};
