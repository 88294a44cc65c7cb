#include "app/dialogs/DecisionButtons.h"

#include <QDialog>
#include <QDialogButtonBox>
#include <QPushButton>

using namespace Qt::StringLiterals;

DecisionButtons MakeDecisionButtons(QDialog& dialog, const QString& agreement) {
    auto* box = new QDialogButtonBox(&dialog);
    auto* agree = box->addButton(agreement, QDialogButtonBox::AcceptRole);
    agree->setObjectName(u"agree"_s);
    auto* cancel = box->addButton(u"Abbrechen"_s, QDialogButtonBox::RejectRole);
    QObject::connect(box, &QDialogButtonBox::accepted, &dialog, &QDialog::accept);
    QObject::connect(box, &QDialogButtonBox::rejected, &dialog, &QDialog::reject);
    return {.Box = box, .Agree = agree, .Cancel = cancel};
}
