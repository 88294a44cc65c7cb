#include "tests/ErrorOf.h"
#include "tests/playback/control/PlayerRig.h"

// Playing in a separate player program.

using namespace Qt::StringLiterals;

namespace {

// What the player program would get and answer; lives longer than the way to it.
struct ExternalScript {
    std::optional<qint64> Running;
    bool Registers = true;
    bool Creates = true;
    QStringList Startable;  // programs
    int ComesUpAfter = 3;   // looks
    std::map<int, qint64> Answers;

    QStringList Log;
    QStringList Started;
    int Waited = 0;  // ms
    FeedbackReceiver* Receiver = nullptr;

    QStringList Take() { return std::exchange(Log, {}); }
};

class ScriptedExternal : public ExternalPlayer {
 public:
    explicit ScriptedExternal(ExternalScript& script) : script_(script) {}

    std::optional<qint64> Find() override { return script_.Running; }
    bool Start(const QString& program, const QString& argument) override {
        script_.Started << program + u' ' + argument;
        return script_.Startable.contains(program);
    }
    void Wait(int milliseconds) override {
        script_.Waited += milliseconds;
        if (script_.Waited == 100 * script_.ComesUpAfter) script_.Running = 1;
    }
    qint64 SendCommand(ExternalCommand command, qint64 parameter) override {
        script_.Log << u"%1 %2"_s.arg(command).arg(parameter);
        return script_.Answers[command];
    }
    qint64 SendText(ExternalCommand command, const QString& text) override {
        script_.Log << u"%1 \"%2\""_s.arg(command).arg(QFileInfo(text).fileName());
        return script_.Answers[command];
    }
    bool RegisterFeedback() override { return script_.Registers; }
    std::optional<qint64> CreateFeedback(FeedbackReceiver& receiver) override {
        if (!script_.Creates) return std::nullopt;
        script_.Receiver = &receiver;
        return 77;
    }

 private:
    ExternalScript& script_;
};

class ExternalTest : public PlayerTest {
 protected:
    ExternalTest() {
        script_.Running = 1;
        player_.SetExternalPlayer(std::make_unique<ScriptedExternal>(script_));
        player_.SetPlayExtern(true);
        player_.SetPanel(&panel_);
    }
    // A song is open there, and what was said until then forgotten.
    void OpenThere(const QString& song) {
        player_.SetFileName(Add(song));
        script_.Take();
        panel_.Log.clear();
    }

    ExternalScript script_;
    ScriptedPanel panel_;
};

TEST_F(ExternalTest, AFileThatMovesIsLetGoOfThereAndTakenUpAgain) {
    TMusicDatabase database;
    player_.SetMusicDatabase(&database);
    OpenThere(u"a.mp3"_s);
    script_.Answers = {{1, 1234}, {4, psPaused}};
    const auto takeUp = database.OnReleaseFile(player_.FileName());
    EXPECT_EQ(script_.Take(), QStringList({u"4 0"_s, u"1 0"_s, u"3 0"_s, u"13 0"_s, u"14 0"_s}));
    takeUp(Add(u"x.mp3"_s));
    EXPECT_EQ(script_.Take(), QStringList({u"17 \"x.mp3\""_s, u"15 0"_s, u"2 1234"_s, u"20 0"_s}));
    player_.SetMusicDatabase(nullptr);
}

// Where feedback goes, then 13 settings, whose values arrive in another test.
constexpr qsizetype kGreeting = 14;

TEST_F(ExternalTest, FirstMeetingTellsAllSettings) {
    player_.SetFileName(Add(u"a.mp3"_s));
    const QStringList greeting = script_.Take();
    ASSERT_EQ(greeting.size(), kGreeting + 1);
    EXPECT_EQ(greeting.first(), u"22 77"_s);
    EXPECT_EQ(greeting.last(), u"17 \"a.mp3\""_s);
    script_.Answers[4] = 99;  // a status that there is not
    EXPECT_EQ(player_.GetStatus(), psClosed);
    EXPECT_EQ(script_.Take(), QStringList(u"4 0"_s));
    player_.SetFileName(Add(u"b.mp3"_s));
    EXPECT_EQ(script_.Take(), QStringList({u"13 0"_s, u"14 0"_s, u"17 \"b.mp3\""_s}));
    EXPECT_EQ(Open(), QString());
}

TEST_F(ExternalTest, CrossFadesAreTheOtherProgramsBusiness) {
    OpenThere(u"a.mp3"_s);
    EXPECT_FALSE(player_.PlayWithCrossFade(Add(u"b.mp3"_s)));
    EXPECT_EQ(player_.FileName(), folder_.Path(u"a.mp3"_s));
    script_.Answers[21] = 1;
    EXPECT_TRUE(player_.PlayWithCrossFade(Add(u"b.mp3"_s)));
    EXPECT_EQ(player_.FileName(), folder_.Path(u"b.mp3"_s));
    EXPECT_EQ(script_.Take(), QStringList({u"21 \"b.mp3\""_s, u"21 \"b.mp3\""_s}));

    player_.SetCOFileName(Add(u"c.mp3"_s));
    EXPECT_EQ(script_.Take(),
              QStringList({u"18 0"_s, u"7 \"c.mp3\""_s, u"8 0"_s, u"10 10000"_s, u"12 1"_s, u"16 0"_s}));
    EXPECT_EQ(player_.COFileName(), folder_.Path(u"c.mp3"_s));
    script_.Running.reset();
    EXPECT_EQ(player_.COFileName(), QString());
}

TEST_F(ExternalTest, PlayerProgramIsStartedAndWaitedFor) {
    script_.Running.reset();
    script_.Startable = {u"TSPlayer/TSPlayer"_s};
    player_.SetFileName(Add(u"a.mp3"_s));
    EXPECT_EQ(script_.Started, QStringList({u"TSPlayer /NoVisible"_s, u"TSPlayer/TSPlayer /NoVisible"_s}));
    EXPECT_EQ(script_.Waited, 300);
    EXPECT_EQ(script_.Take().mid(kGreeting), QStringList(u"17 \"a.mp3\""_s));
    EXPECT_TRUE(Messages().isEmpty());
}

TEST_F(ExternalTest, ALaterPlayerProgramGetsSettingsAndSongAnew) {
    OpenThere(u"a.mp3"_s);
    script_.Running = 2;
    player_.Play();
    EXPECT_EQ(script_.Take().mid(kGreeting), QStringList({u"17 \"a.mp3\""_s, u"15 0"_s}));
}

TEST_F(ExternalTest, WithoutThePlayerProgramTheSongPlaysHere) {
    OpenThere(u"a.mp3"_s);
    script_.Running.reset();
    script_.Startable = {u"TSPlayer"_s};
    script_.ComesUpAfter = 31;
    player_.Play();
    EXPECT_EQ(script_.Waited, 3000);
    EXPECT_EQ(Messages(),
              QStringList{u"Kann das Programm TSPlayer nicht starten. Der Sound wird intern abgespielt."_s});
    EXPECT_FALSE(player_.PlayExtern());
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
}

TEST_F(ExternalTest, SwitchingTakesTheSongAlong) {
    OpenThere(u"a.mp3"_s);
    player_.SetPlayExtern(false);
    EXPECT_EQ(script_.Take(), QStringList({u"13 0"_s, u"14 0"_s}));
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    player_.SetPlayExtern(true);
    EXPECT_EQ(script_.Take(), QStringList(u"17 \"a.mp3\""_s));
    EXPECT_EQ(Open(), QString());
}

TEST_F(ExternalTest, WithoutAPlaceForFeedbackAnExceptionSaysWhy) {
    const auto open = [this] { player_.SetFileName(Add(u"a.mp3"_s)); };
    const QString message = u"Fehler beim Erstellen eines Hilfs-Fensters für EPS-FeedBacks "_s;
    script_.Creates = false;
    EXPECT_EQ(ErrorOf<EPlaySoundException>(open), message + u"(CreateWindow fehlgeschlagen)"_s);
    script_.Registers = false;
    EXPECT_EQ(ErrorOf<EPlaySoundException>(open), message + u"(RegisterClass fehlgeschlagen)"_s);
    EXPECT_TRUE(script_.Take().isEmpty());
}

TEST_F(ExternalTest, ErrorThatFeedbackLeadsToIsToldTheUser) {
    TMusicDatabase database;
    database.SetSortType(stPath);
    player_.SetMusicDatabase(&database);
    for (const QString& song : {u"a.wav"_s, u"b.wav"_s})
        database.AddSong(Add(song));
    OpenThere(u"a.wav"_s);
    Change([](EngineSettings& s) { s.UseFMOD = s.UseMCI = s.UseEldoS = s.UseWinAmp = false; });
    EXPECT_EQ(script_.Receiver->HandleFeedback(1, 0), 0);
    EXPECT_EQ(Messages(), QStringList{u"Keine Engine zum Verwenden freigegeben "
                                      "(UseFMOD, UseMCI, UseEldoS, UseWinAmp, ...)"_s});
}

TEST_F(ExternalTest, FeedbackThatComesTooLateIsNotAboutTheSongThatPlaysHere) {
    OpenThere(u"a.mp3"_s);
    player_.SetPlayExtern(false);
    player_.Play();
    panel_.Log.clear();
    int ends = 0;
    player_.OnReachedEndOfSong = [&](TPlaySound&) { ++ends; };
    for (const int code : {1, 3, 4, 5, 6})
        script_.Receiver->HandleFeedback(code, 4711);
    script_.Receiver->HandleFeedbackText(11, u"/m/x.mp3"_s);
    EXPECT_EQ(ends, 0);
    EXPECT_TRUE(panel_.Log.isEmpty());
    EXPECT_NE(panel_.Position, 4711U);
}

TEST_F(ExternalTest, WithAControllerOfItsOwnTheEndAndTheCountAreNotItsBusiness) {
    TMusicDatabase database;
    player_.SetMusicDatabase(&database);
    database.AddSong(Add(u"a.wav"_s));
    OpenThere(u"a.wav"_s);
    ScriptedController controller;
    int ends = 0;
    player_.OnReachedEndOfSong = [&](TPlaySound&) { ++ends; };
    const auto tell = [this] {
        script_.Receiver->HandleFeedback(1, 0);
        script_.Receiver->HandleFeedback(7, 1);
        return script_.Receiver->HandleFeedback(12, 0);
    };
    player_.SetController(&controller);
    EXPECT_EQ(tell(), 1);
    EXPECT_EQ(ends, 0);
    EXPECT_EQ(database.Song(0).PlayCount, 0U);
    player_.SetController(nullptr);
    tell();
    EXPECT_EQ(ends, 1);
    EXPECT_EQ(database.Song(0).PlayCount, 1U);
}

}  // namespace
