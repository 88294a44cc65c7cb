#include "app/dialogs/NamePatternEdit.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QPushButton>

#include "app/dialogs/NamePatternTexts.h"

using namespace Qt::StringLiterals;

NamePatternEdit::NamePatternEdit(QWidget* parent)
    : QWidget(parent),
      edit_(new QLineEdit(this)),
      insert_(new QPushButton(u"&Platzhalter"_s, this)),
      example_(new QLabel(this)) {
    setFocusProxy(edit_);
    edit_->setObjectName(u"pattern"_s);
    edit_->setAccessibleName(u"Muster für die Dateinamen"_s);
    edit_->setMinimumWidth(30 * fontMetrics().averageCharWidth());
    insert_->setObjectName(u"placeholders"_s);
    insert_->setToolTip(u"Fügt einen Platzhalter an der Schreibmarke ein"_s);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Preferred);
    example_->setObjectName(u"example"_s);
    example_->setTextFormat(Qt::PlainText);
    example_->setWordWrap(true);
    // A long pattern without blanks does not make the window wider.
    QSizePolicy policy = example_->sizePolicy();
    policy.setHorizontalPolicy(QSizePolicy::Ignored);
    example_->setSizePolicy(policy);
    AddPlaceholders();
    auto* layout = new QGridLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setColumnStretch(0, 1);
    layout->addWidget(edit_, 0, 0);
    layout->addWidget(insert_, 0, 1);
    layout->addWidget(example_, 1, 0, 1, 2);
    connect(edit_, &QLineEdit::textChanged, this, [this] { ShowExample(); });
    ShowExample();
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
                [this, name] {
                    edit_->insert(name);
                    edit_->setFocus();
                });
    }
    insert_->setMenu(menu);
}

// What is wrong is said while it is typed, so that nobody has to wait for a message.
void NamePatternEdit::ShowExample() {
    const auto fault = FaultOfPattern(Pattern());
    example_->setText(fault ? *fault : u"Beispiel: "_s + ExampleName(Pattern()));
}
