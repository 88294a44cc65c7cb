#include "tsplayer/PlayerWindow.h"

#include <QBoxLayout>
#include <QFileInfo>
#include <QLabel>
#include <QPushButton>

#include "CommonRUKTools/CommandRunner.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWidth = 360;

QString AsTime(quint32 milliseconds) {
    const quint32 seconds = milliseconds / 1000;
    return u"%1:%2"_s.arg(seconds / 60).arg(seconds % 60, 2, 10, QChar(u'0'));
}

}  // namespace

PlayerWindow::PlayerWindow(TPlaySound& player)
    : player_(player), song_(new QLabel(this)), position_(new QLabel(this)), message_(new QLabel(this)) {
    setWindowTitle(u"TS Player"_s);
    setMinimumWidth(kWidth);
    for (QLabel* label : {song_, message_}) {
        label->setWordWrap(true);
        label->setTextFormat(Qt::PlainText);
    }
    message_->hide();
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(song_);
    layout->addWidget(position_);
    layout->addWidget(Buttons());
    layout->addWidget(message_);
    Clear();
    player_.SetPanel(this);
}

PlayerWindow::~PlayerWindow() {
    player_.SetPanel(nullptr);
}

QWidget* PlayerWindow::Buttons() {
    auto* row = new QWidget(this);
    auto* layout = new QHBoxLayout(row);
    layout->setContentsMargins(0, 0, 0, 0);
    AddButton(*row, u"Play"_s, "media-playback-start", &TPlaySound::Play);
    AddButton(*row, u"Pause"_s, "media-playback-pause", &TPlaySound::PauseResume);
    AddButton(*row, u"Stop"_s, "media-playback-stop", &TPlaySound::Stop);
    layout->addStretch();
    return row;
}

void PlayerWindow::AddButton(QWidget& row, const QString& caption, const char* icon,
                             void (TPlaySound::*operation)()) {
    auto* button = new QPushButton(QIcon::fromTheme(QLatin1StringView(icon)), caption, &row);
    row.layout()->addWidget(button);
    connect(button, &QPushButton::clicked, this, Guarded([this, operation] {
                message_->hide();
                (player_.*operation)();
            }));
}

void PlayerWindow::ShowSong(const QString& fileName) {
    song_->setText(QFileInfo(fileName).fileName());
}

void PlayerWindow::Clear() {
    song_->setText(u"Kein Song geöffnet"_s);
    ShowPosition(0, 0);
}

void PlayerWindow::ShowPosition(quint32 position, quint32 length) {
    position_->setText(AsTime(position) + u" / "_s + AsTime(length));
}

void PlayerWindow::Redraw() {
    if (player_.GetStatus() == psStopped) ShowPosition(0, player_.GetLength());
}

void PlayerWindow::ShowMessage(MessageKind, const QString& text) {
    message_->setText(text);
    message_->show();
    show();
}

int PlayerWindow::Ask(const Question& question) {
    ShowMessage(MessageKind::Warning, question.Text);
    return question.Cancel;
}

std::optional<QString> PlayerWindow::Input(const QString&, const QString& prompt, const QStringList&,
                                           const QString&) {
    ShowMessage(MessageKind::Warning, prompt);
    return std::nullopt;
}

std::optional<QString> PlayerWindow::OpenFile(const FileDialogOptions&) {
    return std::nullopt;
}
QStringList PlayerWindow::OpenFiles(const FileDialogOptions&) {
    return {};
}
std::optional<QString> PlayerWindow::SaveFile(const FileDialogOptions&) {
    return std::nullopt;
}
std::optional<QString> PlayerWindow::ChooseFolder(const QString&, const QString&) {
    return std::nullopt;
}
