// tag_write_bench [SONGS [LARGE [SONGS_FOR_DONORS]]]: changes a text in the tags of MP3 files through the one
// way of the program, with its journal, its flushes and the saving of the collection, beside TagLib's save()
// with its own defaults (ID3v2.4, ID3v1 beside it, APE tags kept out), which has none of the three, on copies
// of the same files; and looks for donors of main genres. TMPDIR says on which disk. All files are in the
// page cache. Medians of several rounds in which the two take turns to be first; processor time is that of
// this process, the kernel's for it included.

#include <fcntl.h>
#include <mpegfile.h>
#include <unistd.h>

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QFile>
#include <QTemporaryDir>
#include <algorithm>
#include <cstdio>
#include <functional>
#include <stdexcept>

#include "CommonRUKTools/CompStr.h"
#include "CommonRUKTools/Errors.h"
#include "MusicManagment/database/batches/GenreDonors.h"
#include "MusicManagment/database/commands/Rules.h"
#include "MusicManagment/database/journal/Journal.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"
#include "bench/ProcessorTime.h"
#include "bench/SongGenerator.h"
#include "bench/SongNames.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kRounds = 5;

// --- Time ---

struct Cost {
    double Wall = 0;       // ms
    double Processor = 0;  // ms
};

Cost CostOf(const std::function<void()>& work) {
    const double before = ProcessorTime(RUSAGE_SELF);
    QElapsedTimer clock;
    clock.start();
    work();
    return {static_cast<double>(clock.nsecsElapsed()) / 1e6, ProcessorTime(RUSAGE_SELF) - before};
}

Cost MedianOf(const std::vector<Cost>& costs) {
    const auto median = [&costs](double Cost::*which) {
        std::vector<double> values;
        for (const Cost& cost : costs)
            values.push_back(cost.*which);
        std::ranges::sort(values);
        return values[values.size() / 2];
    };
    return {median(&Cost::Wall), median(&Cost::Processor)};
}

// What one of the two has left to write is not to be waited for by the other.
void WriteEverythingOut(const QString& folder) {
    const int opened = ::open(QFile::encodeName(folder).constData(), O_RDONLY | O_CLOEXEC);
    if (opened < 0 || ::syncfs(opened) != 0) throw std::runtime_error("cannot flush the folder");
    ::close(opened);
}

// --- The two ---

// A collection of the songs, with its file and its journal in the folder.
class Ours {
 public:
    Ours(const QString& folder, const QStringList& songs) : journal_(folder + u"/journal.tsj"_s) {
        UseRules(database_, Rules::Modern);
        database_.SetAsynchronous(false);
        for (const QString& path : songs)
            database_.AddEntry(path, ReadSong(path, database_.AudioReadOptions()).Tag, AddAs::Loaded);
        database_.SetFileName(folder + u"/songs.tsdb"_s);
        database_.SetAutoSave(-1);
        database_.SaveDatabase(database_.FileName());
        SetJournal(&journal_);
    }
    ~Ours() { SetJournal(nullptr); }
    Ours(const Ours&) = delete;
    Ours& operator=(const Ours&) = delete;

    void Change(QString TID3Tag::*field, const QString& text) {
        std::vector<SongUpdate> updates;
        updates.reserve(static_cast<std::size_t>(database_.Count()));
        for (SongIndex i = 0; i < database_.Count(); ++i) {
            SongUpdate update{.Song = database_.Songs().HandleOf(i), .Record = database_.Song(i)};
            update.Record.*field = text;
            updates.push_back(std::move(update));
        }
        const BatchResult result = UpdateSongs(database_, u"Tags"_s, updates, Renaming::Never);
        if (result.Changed != database_.Count() || !result.Failed.isEmpty())
            throw std::runtime_error("not every song was changed");
    }

 private:
    TMusicDatabase database_;
    Journal journal_;
};

using TagLibSetter = void (TagLib::Tag::*)(const TagLib::String&);

void ChangeWithTagLib(const QStringList& songs, TagLibSetter set, const QString& text) {
    const TagLib::String value(text.toStdWString());
    for (const QString& path : songs) {
        TagLib::MPEG::File file(QFile::encodeName(path).constData(), false);
        (file.tag()->*set)(value);
        if (!file.save()) throw std::runtime_error("TagLib could not save");
    }
}

// --- Writing ---

struct Task {
    const char* Name;
    QString TID3Tag::*Field;
    TagLibSetter Setter;
    // Of the round; unlike those before it.
    std::function<QString(int round)> Text;
};

void CheckTexts(const QStringList& songs, const Task& task, const QString& text) {
    ReadOptions reading;
    reading.Profile = ReadProfile::Modern;
    for (const QString& path : songs)
        if (ReadSong(path, reading).Tag.*task.Field != text)
            throw std::runtime_error("a file does not have its new text");
}

void PrintRow(const char* what, const Cost& ours, const Cost& theirs) {
    std::printf("  %-13s ours %7.0f ms (processor %6.0f)  TagLib %7.0f ms (%6.0f)  ratio %.2f (%.2f)\n", what,
                ours.Wall, ours.Processor, theirs.Wall, theirs.Processor, ours.Wall / theirs.Wall,
                ours.Processor / theirs.Processor);
}

// What the two have cost, round by round.
struct Rounds {
    std::vector<Cost> Ours{};
    std::vector<Cost> TagLib{};
    std::vector<Cost> TagLibFlush{};  // what it does not do, afterwards
};

// The first round also brings the tags of the files into the version that is written.
void Print(const Task& task, qsizetype songs, const Rounds& rounds) {
    std::printf("%s, %lld files\n", task.Name, static_cast<long long>(songs));
    PrintRow("first round", rounds.Ours.front(), rounds.TagLib.front());
    PrintRow("median", MedianOf(rounds.Ours), MedianOf(rounds.TagLib));
    std::printf("  %-13s TagLib's files on the disk: %.0f ms more\n", "", MedianOf(rounds.TagLibFlush).Wall);
    std::fflush(stdout);
}

// Both change their copies, round by round.
void Measure(const Task& task, const QString& folder, const QStringList& songs, const QStringList& copies) {
    Ours ours(folder, songs);
    Rounds rounds;
    for (int round = 0; round < kRounds; ++round) {
        const QString text = task.Text(round);
        const auto takeTurn = [&](bool isOurs) {
            WriteEverythingOut(folder);
            if (isOurs) return rounds.Ours.push_back(CostOf([&] { ours.Change(task.Field, text); }));
            rounds.TagLib.push_back(CostOf([&] { ChangeWithTagLib(copies, task.Setter, text); }));
            rounds.TagLibFlush.push_back(CostOf([&] { WriteEverythingOut(folder); }));
        };
        takeTurn(round % 2 == 0);
        takeTurn(round % 2 != 0);
        CheckTexts(songs, task, text);
        CheckTexts(copies, task, text);
    }
    Print(task, songs.size(), rounds);
}

void MeasureTags(const SongGenerator& generator, const Task& task) {
    const QTemporaryDir folder;
    if (!folder.isValid()) throw std::runtime_error("no folder for the files");
    const QStringList songs = generator.Write(folder.filePath(u"ours"_s));
    const QStringList copies = generator.Write(folder.filePath(u"theirs"_s));
    Measure(task, folder.path(), songs, copies);
}

// --- Donors ---

// Every second artist has songs with a main genre; the others look for the most alike of these.
void MeasureDonors(int songs, int artists) {
    TMusicDatabase database;
    database.BeginLoading();
    for (int i = 0; i < songs; ++i) {
        TID3Tag song;
        const int artist = i % artists;
        song.FileName = u"/music/%1.mp3"_s.arg(i);
        song.Artist = SongNames::Artist(artist);
        song.MainGenre = artist % 2 == 0 ? static_cast<quint8>(1 + artist % 19) : 0;
        database.AddEntry(QString(), std::move(song), AddAs::Loaded);
    }
    database.EndLoading();

    std::optional<GenreDonors> donors;
    const Cost index = CostOf([&] { donors.emplace(database); });
    int found = 0;
    const Cost search = CostOf([&] {
        for (int i = 1; i < artists; i += 2)
            if (donors->MostAlike(SongNames::Artist(i))) ++found;
    });
    // Each song beside each song, for a few of them.
    constexpr int kTried = 10;
    double best = 0;
    const Cost plain = CostOf([&] {
        for (int i = 0; i < kTried; ++i)
            for (SongIndex song = 0; song < database.Count(); ++song)
                best = std::max(best, CompStr(SongNames::Artist(2 * i + 1), database.Song(song).Artist));
    });
    if (found == 0 || best == 0) throw std::runtime_error("no donor was found");
    std::printf(
        "donors for %d songs of %d artists: index %.2f s, search once an artist %.2f s; song by song it "
        "would be %.0f s\n",
        songs, artists, index.Wall / 1e3, search.Wall / 1e3, plain.Wall / 1e3 / kTried * songs / 2);
}

// How many of each; none leaves a task out.
struct Counts {
    int Songs = 10'000;
    int Large = 100;
    int ForDonors = 100'000;
};

void Run(const Counts& counts) {
    const Task fits{"title, tag has room", &TID3Tag::Title, &TagLib::Tag::setTitle,
                    [](int round) { return u"Ein anderer Titel"_s + QString(round % 3, u'!'); }};
    const Task grows{"comment, tag has no room", &TID3Tag::Comment, &TagLib::Tag::setComment,
                     [](int round) { return QString(2000 * (round + 1), u'x'); }};
    SongGenerator many;
    many.Songs = counts.Songs;
    SongGenerator few;
    few.Songs = counts.Large;
    few.AudioBytes = 8'000'000;
    if (counts.Songs > 0) {
        MeasureTags(many, fits);
        many.CoverBytes = 0;
        MeasureTags(many, {"title, tag has room, no covers", fits.Field, fits.Setter, fits.Text});
    }
    if (counts.Large > 0) MeasureTags(few, grows);
    if (counts.ForDonors > 0) MeasureDonors(counts.ForDonors, counts.ForDonors / 10);
}

}  // namespace

int main(int argc, char** argv) {
    const QCoreApplication application(argc, argv);
    Counts counts;
    if (argc > 1) counts.Songs = QByteArray(argv[1]).toInt();
    if (argc > 2) counts.Large = QByteArray(argv[2]).toInt();
    if (argc > 3) counts.ForDonors = QByteArray(argv[3]).toInt();
    try {
        Run(counts);
    } catch (const std::exception& error) {
        std::fprintf(stderr, "%s\n", error.what());
        return 1;
    }
    return 0;
}
