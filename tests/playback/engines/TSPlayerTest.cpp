// The real player program, with everything but a sound card.

#include <QTemporaryDir>

#include "MusicManagment/playback/extern/LocalExternalPlayer.h"
#include "MusicManagment/playback/winamp/Waiting.h"
#include "tests/playback/SoundFiles.h"
#include "tests/playback/control/PlayerRig.h"
#include "tests/playback/engines/Patience.h"

using namespace Qt::StringLiterals;

namespace {

TEST(TSPlayerTest, IsStartedPlaysASongToItsEndAndEndsWithItsController) {
    const QTemporaryDir folder;
    qputenv("XDG_RUNTIME_DIR", folder.path().toUtf8());
    qputenv("TUNESTEAD_AUDIO", "null");
    ScriptedDialogs dialogs;
    const QString song = folder.filePath(u"Töne.wav"_s);
    WriteWav(song, Sine({}, 2));
    const QString path = PlayerChannelPath();

    auto player = std::make_unique<TPlaySound>(EngineTable());
    player->SetExternalPlayer(std::make_unique<LocalExternalPlayer>(path));
    quint32 position = 0;
    bool ended = false;
    player->OnPlaying = [&](TPlaySound&, quint32 now) { position = std::max(position, now); };
    player->OnReachedEndOfSong = [&](TPlaySound&) { ended = true; };
    player->SetPlayExtern(true);
    player->SetFileName(song);
    ASSERT_TRUE(player->PlayExtern());
    EXPECT_TRUE(dialogs.Messages.empty());
    EXPECT_EQ(player->GetLength(), 2000U);
    player->Play();
    EXPECT_TRUE(WaitUntil([&] { return ended; }, kPatience));
    EXPECT_GT(position, 1000U);

    player.reset();
    LocalExternalPlayer another(path);
    EXPECT_TRUE(WaitUntil([&] { return !another.Find().has_value(); }, kPatience));
}

}  // namespace
