#include "app/views/VisPlaySound.h"

#include <QComboBox>
#include <QEvent>
#include <QHBoxLayout>
#include <QLabel>
#include <QToolButton>
#include <algorithm>
#include <limits>

#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/MenuItem.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "app/MenuIcons.h"
#include "app/models/SoundOutputs.h"
#include "app/views/ElidedLabel.h"
#include "app/views/SeekSlider.h"
#include "app/views/VolumeSlider.h"

using namespace Qt::StringLiterals;

namespace {

constexpr quint32 kSecond = 1000;  // milliseconds
constexpr int kNarrow = 70;        // average characters: below it the parts stand one above the other
constexpr quint32 kLongest = static_cast<quint32>(std::numeric_limits<int>::max());

struct ModeCaption {
    TCrossover Mode;
    const char16_t* Caption;
};

constexpr ModeCaption kModes[] = {
    {coNone, u"Kein Überblenden"},
    {coAutoChange, u"Am Ende des Lieds"},
    {coAllChanges, u"Bei jedem Wechsel"},
    {coAlways, u"Immer"},
};

QString TimeText(quint32 milliseconds) {
    return FormatLength(static_cast<int>(milliseconds / kSecond), true);
}

}  // namespace

TVisPlaySound::TVisPlaySound(TPlaySound& player, const TPlayList& list, QWidget* parent)
    : QWidget(parent),
      player_(player),
      list_(list),
      layout_(new QBoxLayout(QBoxLayout::LeftToRight, this)),
      title_(new ElidedLabel(this)),
      artist_(new ElidedLabel(this)),
      slider_(new SeekSlider(this)),
      elapsed_(new QLabel(this)),
      remaining_(new QLabel(this)),
      volume_(new VolumeSlider(this)),
      crossover_(new QComboBox(this)) {
    setObjectName(u"visPlaySound"_s);
    setAccessibleName(u"Player"_s);
    SetUpSlider();
    SetUpCrossover();
    layout_->setSizeConstraint(QLayout::SetNoConstraint);  // minimumSizeHint tells how small it can be
    layout_->setContentsMargins(8, 4, 8, 4);
    layout_->setSpacing(8);
    buttons_ = MakeButtons();
    layout_->addWidget(buttons_);
    layout_->addWidget(MakeSong(), 1);
    layout_->addWidget(volume_);
    layout_->addWidget(crossover_);
    FitToFont();
    player_.SetPanel(this);
    Redraw();
}

TVisPlaySound::~TVisPlaySound() {
    if (player_.Panel() == this) player_.SetPanel(nullptr);
}

// --- Parts ---

QToolButton* TVisPlaySound::AddButton(QBoxLayout& row, int command, const QString& caption) {
    auto* button = new QToolButton(this);
    button->setObjectName(u"player%1"_s.arg(command));
    button->setIcon(MenuIcon(player_.Menu().Find(command)->Icon()));
    button->setAutoRaise(true);
    button->setFocusPolicy(Qt::TabFocus);
    button->setAccessibleName(caption);
    button->setToolTip(caption);
    row.addWidget(button);
    return button;
}

QWidget* TVisPlaySound::MakeButtons() {
    auto* buttons = new QWidget(this);
    auto* row = new QHBoxLayout(buttons);
    row->setContentsMargins(0, 0, 0, 0);
    row->setSpacing(2);
    row->addStretch(1);
    previous_ = AddButton(*row, plPrevious, u"Vorheriges (F9)"_s);
    play_ = AddButton(*row, plPlay, u"Play (F5)"_s);
    stop_ = AddButton(*row, plStop, u"Stop (F7)"_s);
    next_ = AddButton(*row, plNext, u"Nächstes (F10)"_s);
    row->addStretch(1);
    const auto press = [this](QToolButton* button, int command) {
        connect(button, &QToolButton::clicked, this,
                Guarded([this, command] { player_.ClickMenuItem(command); }));
    };
    press(previous_, plPrevious);
    press(stop_, plStop);
    press(next_, plNext);
    connect(play_, &QToolButton::clicked, this,
            Guarded([this] { player_.ClickMenuItem(player_.GetStatus() == psPlaying ? plPause : plPlay); }));
    return buttons;
}

QWidget* TVisPlaySound::MakeSong() {
    auto* song = new QWidget(this);
    auto* column = new QVBoxLayout(song);
    column->setContentsMargins(0, 0, 0, 0);
    column->setSpacing(2);
    auto* texts = new QHBoxLayout;
    // Both are shortened where they do not fit.
    for (ElidedLabel* label : {title_, artist_})
        label->setMinimumWidth(1);
    texts->addWidget(title_, 3);
    texts->addWidget(artist_, 2);
    artist_->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    title_->setObjectName(u"songTitle"_s);
    artist_->setObjectName(u"songArtist"_s);
    column->addLayout(texts);
    auto* times = new QHBoxLayout;
    times->addWidget(elapsed_);
    times->addWidget(slider_, 1);
    times->addWidget(remaining_);
    elapsed_->setObjectName(u"elapsed"_s);
    elapsed_->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    elapsed_->setAccessibleName(u"Gespielt"_s);
    remaining_->setObjectName(u"remaining"_s);
    remaining_->setAccessibleName(u"Restzeit und Länge"_s);
    column->addLayout(times);
    return song;
}

void TVisPlaySound::SetUpSlider() {
    slider_->OnDrag = [this](int position) { ShowTimes(static_cast<quint32>(position)); };
    slider_->OnSeek = [this](int position) {
        ShowTimes(static_cast<quint32>(position));
        RunCommand([&] { player_.SetPosition(static_cast<quint32>(position)); });
    };
}

void TVisPlaySound::SetUpCrossover() {
    crossover_->setObjectName(u"crossover"_s);
    crossover_->setAccessibleName(u"Überblenden"_s);
    crossover_->setToolTip(u"Wann ein Lied in das nächste überblendet"_s);
    for (const auto& [mode, caption] : kModes)
        crossover_->addItem(QString::fromUtf16(caption), mode);
    SetCrossover(coAutoChange);
}

// --- Arrangement ---

void TVisPlaySound::resizeEvent(QResizeEvent* event) {
    QWidget::resizeEvent(event);
    Arrange();
}

void TVisPlaySound::changeEvent(QEvent* event) {
    QWidget::changeEvent(event);
    if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange) FitToFont();
}

// A strip can always be made narrower: it then becomes a stack.
QSize TVisPlaySound::minimumSizeHint() const {
    int width = 0;
    for (int i = 0; i < layout_->count(); ++i)
        width = std::max(width, layout_->itemAt(i)->minimumSize().width());
    const QMargins margins = layout_->contentsMargins();
    return {margins.left() + width + margins.right(), QWidget::minimumSizeHint().height()};
}

void TVisPlaySound::Arrange() {
    const bool narrow = width() < kNarrow * fontMetrics().averageCharWidth();
    layout_->setDirection(narrow ? QBoxLayout::TopToBottom : QBoxLayout::LeftToRight);
    layout_->removeWidget(buttons_);
    layout_->insertWidget(narrow ? 1 : 0, buttons_);  // below the song or left of it
    // A strip takes no more of the window than it needs.
    setMaximumHeight(narrow ? QWIDGETSIZE_MAX : sizeHint().height());
}

// Times that change do not move what stands beside them.
void TVisPlaySound::FitToFont() {
    QFont bold = font();
    bold.setBold(true);
    title_->setFont(bold);
    elapsed_->setMinimumWidth(fontMetrics().horizontalAdvance(u"00:00"_s));
    remaining_->setMinimumWidth(fontMetrics().horizontalAdvance(u"−00:00 / 00:00"_s));
    const int side = std::max(fontMetrics().height() * 3 / 2, 22);
    for (QToolButton* button : {previous_, play_, stop_, next_})
        if (button != nullptr) button->setIconSize({side, side});
    Arrange();
}

// --- What the player tells ---

void TVisPlaySound::ShowSong(const QString&) {
    Redraw();
}

void TVisPlaySound::Clear() {
    Redraw();
}

void TVisPlaySound::Redraw() {
    song_ = SongOf(player_, list_);
    const bool open = player_.GetStatus() != psClosed;
    if (!open) song_ = {};
    ShowTexts();
    ShowState();
    ShowPosition(open ? player_.GetPosition() : 0, open ? player_.GetLength() : 0);
}

void TVisPlaySound::ShowTexts() {
    title_->setText(song_.FileName.isEmpty() ? u"Kein Lied"_s : song_.Title);
    artist_->setText(player_.AwaitsOutput() ? u"Wartet auf die Tonausgabe"_s : song_.Artist);
    setToolTip(song_.FileName.isEmpty() ? QString() : song_.FileName + u'\n' + EngineText());
}

void TVisPlaySound::ShowState() {
    const TPSStatus status = player_.GetStatus();
    const bool playing = status == psPlaying;
    play_->setIcon(MenuIcon(playing ? u"media-playback-pause" : u"media-playback-start"));
    play_->setAccessibleName(playing ? u"Pause"_s : u"Play"_s);
    play_->setToolTip(playing ? u"Pause (F6)"_s : u"Play (F5)"_s);
    stop_->setEnabled(playing || status == psPaused);
    previous_->setEnabled(list_.HasPrevious());
    volume_->setEnabled(!player_.PlayExtern());  // the other program has its own
}

QString TVisPlaySound::EngineText() const {
    const auto engine = player_.CurrentEngine();
    if (!engine) return {};
    const QString output =
        SoundOutputNames().value(static_cast<qsizetype>(player_.Engines().FMODSoundOutputTypes));
    if (*engine != TEngine::FMOD || output.isEmpty()) return EngineName(*engine);
    return EngineName(*engine) + u", Ausgabe: "_s + output;
}

void TVisPlaySound::ShowPosition(quint32 position, quint32 length) {
    length_ = std::min(length, kLongest);
    slider_->ShowPosition(static_cast<int>(std::min(position, length_)), static_cast<int>(length_));
    if (!slider_->IsDragging()) ShowTimes(position);
}

void TVisPlaySound::ShowTimes(quint32 position) {
    if (length_ == 0) {
        elapsed_->setText(song_.FileName.isEmpty() ? QString() : TimeText(position));
        remaining_->clear();
        return;
    }
    elapsed_->setText(TimeText(position));
    remaining_->setText(
        u"−%1 / %2"_s.arg(TimeText(length_ - std::min(position, length_)), TimeText(length_)));
}

TCrossover TVisPlaySound::Crossover() const {
    return static_cast<TCrossover>(crossover_->currentData().toInt());
}

void TVisPlaySound::SetCrossover(TCrossover mode) {
    crossover_->setCurrentIndex(std::max(crossover_->findData(mode), 0));
}
