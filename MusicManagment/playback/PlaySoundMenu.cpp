#include "MusicManagment/playback/PlaySoundMenu.h"

#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/playback/PlaySound.h"

namespace {

constexpr MenuLine kLines[] = {plPlay,     plPause, plStop,    kSeparator, plPrevious, plNext,
                               kSeparator, plBack,  plForward, kSeparator, plMarkSong};
constexpr MenuOutline kMenu{u"Player", kLines};

}  // namespace

CommandDispatcher& TPlaySound::Commands() {
    if (commands_) return *commands_;
    commands_ = std::make_unique<CommandDispatcher>(kMenu);
    for (const PlayerCommands& capability : {kSongCommands, kFadeCommands})
        commands_->Register(*this, capability);
    return *commands_;
}

TMenuExItem& TPlaySound::Menu() {
    return Commands().Menu();
}

bool TPlaySound::ClickMenuItem(int id) {
    return Commands().Run(id);
}
