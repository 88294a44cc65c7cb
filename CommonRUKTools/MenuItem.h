#pragma once

#include <QString>
#include <QtGlobal>
#include <functional>
#include <memory>
#include <utility>
#include <vector>

// A menu without a toolkit: a tree of captioned items that components build and the shell shows.
class TMenuExItem {
 public:
    enum class ItemKind { Submenu, Command, Separator, Radio };

    TMenuExItem(ItemKind kind, QString caption, int id = 0, QString shortcut = QString())
        : kind_(kind), caption_(std::move(caption)), id_(id), shortcut_(std::move(shortcut)) {}

    ItemKind Kind() const { return kind_; }
    const QString& Caption() const { return caption_; }
    void SetCaption(const QString& caption) { caption_ = caption; }
    // By which the keyboard chooses the item; null: any letter of the caption.
    QChar Letter() const { return letter_; }
    void SetLetter(QChar letter) { letter_ = letter; }
    // Number of the command; 0 for separators and submenus without one.
    int Id() const { return id_; }
    // As "Ctrl+Alt+N"; empty for none.
    const QString& Shortcut() const { return shortcut_; }

    // Number of the picture beside the caption; -1 none.
    int ImageIndex() const { return imageIndex_; }
    void SetImageIndex(int index) { imageIndex_ = index; }

    // Its name in the freedesktop icon themes; empty for none.
    const QString& Icon() const { return icon_; }
    void SetIcon(const QString& icon) { icon_ = icon; }

    bool Enabled() const { return enabled_; }
    void SetEnabled(bool enabled) { enabled_ = enabled; }
    // Why the item is disabled or what it does; empty for none.
    const QString& Hint() const { return hint_; }
    void SetHint(const QString& hint) { hint_ = hint; }
    // For radio items, and for commands that switch something on and off.
    bool Checkable() const { return kind_ == ItemKind::Radio || checkable_; }
    void SetCheckable(bool checkable) { checkable_ = checkable; }
    bool Checked() const { return checked_; }
    void SetChecked(bool checked) { checked_ = checked; }
    // Shown bold, run by a double click.
    bool IsDefault() const { return isDefault_; }
    void SetDefault(bool isDefault) { isDefault_ = isDefault; }

    const std::vector<std::unique_ptr<TMenuExItem>>& Items() const { return items_; }
    TMenuExItem& Add(ItemKind kind, const QString& caption, int id = 0, const QString& shortcut = QString()) {
        return Insert(items_.size(), kind, caption, id, shortcut);
    }
    // In front of the item at this place.
    TMenuExItem& Insert(std::size_t place, ItemKind kind, const QString& caption, int id = 0,
                        const QString& shortcut = QString()) {
        const auto next = items_.begin() + static_cast<std::ptrdiff_t>(place);
        return **items_.insert(next, std::make_unique<TMenuExItem>(kind, caption, id, shortcut));
    }
    // The item with this number in this tree; nullptr when there is none.
    const TMenuExItem* Find(int id) const;
    TMenuExItem* Find(int id) { return const_cast<TMenuExItem*>(std::as_const(*this).Find(id)); }

 private:
    ItemKind kind_;
    QString caption_;
    int id_;
    QString shortcut_;
    QString hint_;
    QString icon_;
    QChar letter_;
    int imageIndex_ = -1;
    bool enabled_ = true;
    bool checkable_ = false;
    bool checked_ = false;
    bool isDefault_ = false;
    std::vector<std::unique_ptr<TMenuExItem>> items_;
};
