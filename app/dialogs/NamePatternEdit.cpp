#include "app/dialogs/NamePatternEdit.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QPushButton>

#include "CommonRUKTools/CommandRunner.h"
#include "app/dialogs/NamePatternTexts.h"

using namespace Qt::StringLiterals;

namespace {

// What is wrong is said while it is typed, so that nobody has to wait for a message.
QString ExampleOf(const QString& pattern) {
    return FaultOfPattern(pattern).value_or(u"Beispiel: "_s + ExampleName(pattern));
}

}  // namespace

NamePatternEdit::NamePatternEdit(QWidget* parent)
    : QWidget(parent),
      edit_(new QLineEdit(this)),
      insert_(new QPushButton(u"&Platzhalter"_s, this)),
      shown_(new QLabel(this)),
      description_(ExampleOf) {
    setFocusProxy(edit_);
    edit_->setObjectName(u"pattern"_s);
    edit_->setAccessibleName(u"Muster für die Dateinamen"_s);
    edit_->setMinimumWidth(30 * fontMetrics().averageCharWidth());
    insert_->setObjectName(u"placeholders"_s);
    insert_->setToolTip(u"Fügt einen Platzhalter an der Schreibmarke ein"_s);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Preferred);
    shown_->setObjectName(u"example"_s);
    shown_->setTextFormat(Qt::PlainText);
    shown_->setWordWrap(true);
    // A long pattern without blanks does not make the window wider.
    QSizePolicy policy = shown_->sizePolicy();
    policy.setHorizontalPolicy(QSizePolicy::Ignored);
    shown_->setSizePolicy(policy);
    AddPlaceholders();
    auto* layout = new QGridLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setColumnStretch(0, 1);
    layout->addWidget(edit_, 0, 0);
    layout->addWidget(insert_, 0, 1);
    layout->addWidget(shown_, 1, 0, 1, 2);
    connect(edit_, &QLineEdit::textChanged, this, Guarded([this] { ShowDescription(); }));
    ShowDescription();
}

QString NamePatternEdit::Pattern() const {
    return edit_->text();
}

void NamePatternEdit::SetPattern(const QString& pattern) {
    edit_->setText(pattern);
    edit_->setCursorPosition(0);
}

void NamePatternEdit::AddPlaceholders() {
    auto* menu = new QMenu(insert_);
    for (const PlaceholderText& text : PlaceholderTexts()) {
        const QString name = QString::fromUtf16(text.Name);
        connect(menu->addAction(QString::fromUtf16(text.Meaning) + u'\t' + name), &QAction::triggered, this,
                Guarded([this, name] {
                    edit_->insert(name);
                    edit_->setFocus();
                }));
    }
    insert_->setMenu(menu);
}

void NamePatternEdit::SetDescription(Description description) {
    description_ = std::move(description);
    ShowDescription();
}

void NamePatternEdit::ShowDescription() {
    shown_->setText(description_(Pattern()));
}
