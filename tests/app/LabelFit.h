#pragma once

#include <QAbstractButton>
#include <QApplication>
#include <QLabel>
#include <QStringList>
#include <QWidget>

// The captions within `window` that are visible and have less room than they need.
inline QStringList ClippedCaptions(const QWidget& window) {
    QStringList clipped;
    for (const auto* label : window.findChildren<QLabel*>()) {
        if (!label->isVisible() || label->text().isEmpty()) continue;
        const bool fits = label->wordWrap() ? label->heightForWidth(label->width()) <= label->height()
                                            : label->sizeHint().width() <= label->width();
        if (!fits) clipped << label->text();
    }
    for (const auto* button : window.findChildren<QAbstractButton*>())
        if (button->isVisible() && !button->text().isEmpty() && button->sizeHint().width() > button->width())
            clipped << button->text();
    return clipped;
}

// The key letters that more than one visible caption within `window` has.
inline QStringList AmbiguousKeys(const QWidget& window) {
    QStringList seen;
    QStringList ambiguous;
    const auto add = [&](const QString& text) {
        const auto mark = text.indexOf(QLatin1Char('&'));
        if (mark < 0) return;
        const QString letter = text.mid(mark + 1, 1).toLower();
        (seen.contains(letter) ? ambiguous : seen) << letter;
    };
    for (const auto* label : window.findChildren<QLabel*>())
        if (label->isVisible() && label->buddy() != nullptr) add(label->text());
    for (const auto* button : window.findChildren<QAbstractButton*>())
        if (button->isVisible()) add(button->text());
    return ambiguous;
}

// Runs `check` with the program's font in every size that users choose, and restores it.
template <typename Check>
void WithEveryFontSize(Check check) {
    const QFont before = QApplication::font();
    for (int size = 9; size <= 16; ++size) {
        QFont font = before;
        font.setPointSize(size);
        QApplication::setFont(font);
        check(size);
    }
    QApplication::setFont(before);
}
