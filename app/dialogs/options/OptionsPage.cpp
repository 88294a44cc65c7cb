#include "app/dialogs/options/OptionsPage.h"

#include <QCheckBox>
#include <QFormLayout>
#include <QGroupBox>
#include <QLabel>
#include <QStyle>
#include <QVBoxLayout>

using namespace Qt::StringLiterals;

namespace {

void Name(QWidget& field, const QString& name, const QString& caption, const QString& toolTip) {
    field.setObjectName(name);
    field.setAccessibleName(QString(caption).remove(u'&'));
    field.setToolTip(toolTip);
}

QLabel* LabelFor(QWidget& field, const QString& caption, const QString& toolTip) {
    auto* label = new QLabel(caption + u':');
    label->setBuddy(&field);
    label->setToolTip(toolTip);
    return label;
}

QLabel* WrappedText(const QString& text) {
    auto* label = new QLabel(text);
    label->setWordWrap(true);
    return label;
}

}  // namespace

OptionsPage::OptionsPage(const QString& caption, const QIcon& icon)
    : caption_(caption), icon_(icon), groups_(new QVBoxLayout(this)) {
    setObjectName(caption);
    groups_->addStretch();
}

QFormLayout& OptionsPage::AddGroup(const QString& title) {
    auto* box = new QGroupBox(title, this);
    auto* form = new QFormLayout(box);
    form->setFieldGrowthPolicy(QFormLayout::ExpandingFieldsGrow);
    form->setRowWrapPolicy(QFormLayout::WrapLongRows);
    groups_->insertWidget(groups_->count() - 1, box);
    return *form;
}

QCheckBox* OptionsPage::AddCheck(QFormLayout& group, const QString& name, const QString& caption,
                                 const QString& toolTip) {
    auto* box = new QCheckBox(caption);
    Name(*box, name, caption, toolTip);
    group.addRow(box);
    return box;
}

void OptionsPage::AddText(QFormLayout& group, const QString& text) {
    group.addRow(WrappedText(text));
}

// Stands below the caption of the choice, not below its mark.
void OptionsPage::AddExplanation(QFormLayout& group, const QString& text) {
    QLabel* label = WrappedText(text);
    const QStyle& style = *label->style();
    label->setContentsMargins(style.pixelMetric(QStyle::PM_ExclusiveIndicatorWidth) +
                                  style.pixelMetric(QStyle::PM_RadioButtonLabelSpacing),
                              0, 0, 0);
    group.addRow(label);
}

void OptionsPage::AddRow(QFormLayout& group, const QString& name, const QString& caption, QWidget& field,
                         const QString& toolTip) {
    Name(field, name, caption, toolTip);
    group.addRow(LabelFor(field, caption, toolTip), &field);
}

void OptionsPage::AddWideRow(QFormLayout& group, const QString& name, const QString& caption, QWidget& field,
                             const QString& toolTip) {
    Name(field, name, caption, toolTip);
    group.addRow(LabelFor(field, caption, toolTip));
    group.addRow(&field);
}

void OptionsPage::SetAvailable(QFormLayout& group, bool available, const QString& reason) {
    QWidget* box = group.parentWidget();
    box->setEnabled(available);
    if (available) return;
    box->setToolTip(reason);
    for (auto* child : box->findChildren<QWidget*>())
        child->setToolTip(reason);
}
