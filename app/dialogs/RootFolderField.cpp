#include "app/dialogs/RootFolderField.h"

#include <QDir>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QPushButton>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/Dialogs.h"

using namespace Qt::StringLiterals;

RootFolderField::RootFolderField(const QString& caption, QWidget* parent)
    : QWidget(parent), edit_(new QLineEdit(this)), choose_(new QPushButton(u"&Durchsuchen..."_s, this)) {
    setFocusProxy(edit_);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Preferred);
    edit_->setObjectName(u"folder"_s);
    edit_->setAccessibleName(caption);
    edit_->setMinimumWidth(25 * fontMetrics().averageCharWidth());
    choose_->setObjectName(u"chooseFolder"_s);
    auto* layout = new QHBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(edit_, 1);
    layout->addWidget(choose_);
    connect(choose_, &QPushButton::clicked, this, [this, caption] {
        if (const auto folder = UserDialogs().ChooseFolder(caption)) SetFolder(*folder);
    });
}

// A relative path has no meaning here: it would depend on where the program was started.
QString RootFolderField::Folder() const {
    const QString text = QDir::fromNativeSeparators(edit_->text().trimmed());
    return QDir::isAbsolutePath(text) ? AbsolutePath(text) : text;
}

void RootFolderField::SetFolder(const QString& folder) {
    edit_->setText(QDir::toNativeSeparators(folder));
    edit_->setCursorPosition(0);
}

std::optional<QString> RootFolderField::Fault() const {
    const QString folder = Folder();
    const QString shown = QDir::toNativeSeparators(folder);
    if (folder.isEmpty()) return u"Der Stammordner fehlt."_s;
    if (!QDir::isAbsolutePath(folder))
        return u"Der Stammordner "_s + shown + u" ist kein vollständiger Pfad."_s;
    const QFileInfo info(folder);
    if (info.isDir()) return std::nullopt;
    if (info.exists()) return shown + u" ist kein Ordner."_s;
    const QString question = u"Der Ordner "_s + shown + u" ist nicht vorhanden. Soll er angelegt werden?"_s;
    if (!UserDialogs().Confirm(question, u"Anlegen"_s, ReturnKey::Agrees)) return QString();
    if (QDir().mkpath(folder)) return std::nullopt;
    return u"Kann den Ordner "_s + shown + u" nicht anlegen."_s;
}
