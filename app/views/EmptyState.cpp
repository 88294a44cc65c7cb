#include "app/views/EmptyState.h"

#include <QIcon>
#include <QLabel>
#include <QPainter>
#include <QPushButton>
#include <QVBoxLayout>

#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kPictureSize = 96;

QLabel* MakeText(const QString& text, double scale, QWidget* parent) {
    auto* label = new QLabel(text, parent);
    label->setAlignment(Qt::AlignCenter);
    label->setWordWrap(true);
    QFont font = label->font();
    font.setPointSizeF(font.pointSizeF() * scale);
    label->setFont(font);
    return label;
}

}  // namespace

EmptyState::EmptyState(QWidget* parent) : QWidget(parent) {
    setObjectName(u"emptyState"_s);
    setBackgroundRole(QPalette::Base);
    setAutoFillBackground(true);
    auto* picture = new QLabel(this);
    picture->setPixmap(ProgramIcon().pixmap(kPictureSize));
    picture->setAlignment(Qt::AlignCenter);
    addFolder_ = MakeButton(u"&Ordner zur Datenbank hinzufügen..."_s,
                            ThemeIcon(u"folder-music"_s, QStyle::SP_DirIcon), &EmptyState::OnAddFolder);
    addSongs_ = MakeButton(u"Songs &zur Datenbank hinzufügen..."_s,
                           ThemeIcon(u"audio-x-generic"_s, QStyle::SP_FileIcon), &EmptyState::OnAddSongs);
    setFocusProxy(addFolder_);

    auto* layout = new QVBoxLayout(this);
    layout->addStretch();
    layout->addWidget(picture);
    layout->addWidget(MakeText(u"Ihre Musiksammlung ist noch leer"_s, 1.5, this));
    layout->addWidget(MakeText(
        u"Ziehen Sie Ordner oder Songs in dieses Fenster, oder wählen Sie sie hier aus."_s, 1, this));
    layout->addSpacing(fontMetrics().height());
    layout->addWidget(addFolder_, 0, Qt::AlignHCenter);
    layout->addWidget(addSongs_, 0, Qt::AlignHCenter);
    layout->addStretch();
}

QPushButton* EmptyState::MakeButton(const QString& text, const QIcon& icon,
                                    std::function<void()> EmptyState::*event) {
    auto* button = new QPushButton(icon, text, this);
    button->setAutoDefault(true);
    connect(button, &QPushButton::clicked, this, [this, event] {
        if (this->*event) (this->*event)();
    });
    return button;
}

void EmptyState::SetCommandsEnabled(bool enabled) {
    addFolder_->setEnabled(enabled);
    addSongs_->setEnabled(enabled);
}

void EmptyState::SetDropMark(bool marked) {
    dropMark_ = marked;
    update();
}

void EmptyState::paintEvent(QPaintEvent*) {
    if (!dropMark_) return;
    const int margin = fontMetrics().height();
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(palette().color(QPalette::Highlight), 3, Qt::DashLine));
    painter.drawRoundedRect(rect().adjusted(margin, margin, -margin, -margin), margin, margin);
}
