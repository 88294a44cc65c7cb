#include "app/dialogs/TagPreviewDialog.h"

#include <QDialogButtonBox>
#include <QPushButton>
#include <QVBoxLayout>

#include "app/dialogs/DecisionButtons.h"
#include "app/views/TagPreviewList.h"
#include "app/views/WrappedLabel.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWidth = 90;   // average characters
constexpr int kHeight = 26;  // lines

}  // namespace

TagPreviewDialog::TagPreviewDialog(const QString& title, const QString& agreement, TagPreview preview,
                                   QWidget* parent)
    : QDialog(parent) {
    setObjectName(u"tagPreviewDialog"_s);
    setWindowTitle(title);
    auto* summary = new WrappedLabel(u"summary"_s, this);
    summary->setText(PreviewSummary(preview, QString(agreement).remove(u'&')));
    auto* list = new TagPreviewList(this);
    list->setAccessibleName(title);
    list->SetRows(std::move(preview.Rows));
    const DecisionButtons buttons = MakeDecisionButtons(*this, agreement);
    buttons.Cancel->setDefault(true);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(list, 1);
    layout->addWidget(summary);
    layout->addWidget(buttons.Box);
    resize(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
}
