#include "app/dialogs/options/WatchChanges.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QComboBox>
#include <QLineEdit>

void WatchChanges(QWidget& page, const std::function<void()>& changed) {
    for (auto* button : page.findChildren<QAbstractButton*>())
        if (button->isCheckable()) QObject::connect(button, &QAbstractButton::toggled, &page, changed);
    for (auto* choice : page.findChildren<QComboBox*>())
        QObject::connect(choice, &QComboBox::currentIndexChanged, &page, changed);
    // Also those within spin boxes.
    for (auto* edit : page.findChildren<QLineEdit*>())
        QObject::connect(edit, &QLineEdit::textChanged, &page, changed);
    for (auto* view : page.findChildren<QAbstractItemView*>()) {
        QAbstractItemModel* model = view->model();
        QObject::connect(model, &QAbstractItemModel::dataChanged, &page, changed);
        QObject::connect(model, &QAbstractItemModel::rowsInserted, &page, changed);
        QObject::connect(model, &QAbstractItemModel::rowsRemoved, &page, changed);
        QObject::connect(model, &QAbstractItemModel::modelReset, &page, changed);
    }
}
