#include "MusicManagment/database/batches/GenreAdaption.h"

#include <QHash>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/batches/BatchFrame.h"
#include "MusicManagment/database/batches/GenreDonors.h"
#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

constexpr BatchTexts kTexts = {.All = u"Anpassen des Genres aller Songs",
                               .Marked = u"Anpassen des Genres aller markierter Songs",
                               .One = u"Anpassen des Genres"};

bool UserTakes(const QString& artist, const GenreDonors::Likeness& like) {
    const QString text = u"Soll für "_s + artist + u" der Artist "_s + like.From.Artist +
                         u" verwendet werden ("_s + QString::number(like.Percent) + u"% Übereinstimmung)"_s;
    return UserDialogs().AskYesNo(text);
}

// Finds donors, and asks where they are not certain.
class DonorChoice {
 public:
    explicit DonorChoice(const TMusicDatabase& database)
        : donors_(database), asksOnce_(database.QuietBatches()) {}

    std::optional<GenreDonors::Donor> For(const QString& artist) {
        if (const auto* same = donors_.OfArtist(artist)) return *same;
        if (!asksOnce_) return AlikeOne(artist);
        const QString folded = artist.toCaseFolded();
        const auto known = answers_.constFind(folded);
        return known != answers_.cend() ? *known : *answers_.insert(folded, AlikeOne(artist));
    }

 private:
    std::optional<GenreDonors::Donor> AlikeOne(const QString& artist) {
        auto known = likenesses_.constFind(artist);
        if (known == likenesses_.cend()) known = likenesses_.insert(artist, donors_.MostAlike(artist));
        const auto& like = *known;
        return like && UserTakes(artist, *like) ? std::optional(like->From) : std::nullopt;
    }

    GenreDonors donors_;
    bool asksOnce_;
    QHash<QString, std::optional<GenreDonors::Likeness>> likenesses_;
    QHash<QString, std::optional<GenreDonors::Donor>> answers_;
};

}  // namespace

GenreAdaption AdaptGenres(TMusicDatabase& database, const BatchSongs& songs) {
    GenreAdaption result;
    DonorChoice donors(database);
    const auto update = [&](const TID3Tag& song) -> std::optional<TID3Tag> {
        if (song.MainGenre != 0) return std::nullopt;
        if (const auto donor = donors.For(song.Artist)) {
            TID3Tag changed = song;
            changed.MainGenre = donor->MainGenre;
            changed.Artist = donor->Artist;
            return changed;
        }
        const QString name = ArtistAndTitle(song);
        result.WithoutGenre << name;
        if (!database.QuietBatches())
            UserDialogs().ShowMessage(MessageKind::Error,
                                      u"Kann kein passendes Genre für den Song "_s + name + u" finden."_s);
        return std::nullopt;
    };
    result.Updates = RunBatch(database, songs, kTexts, u"Genre anpassen"_s, update);
    return result;
}
