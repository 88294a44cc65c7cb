#include "app/dialogs/wizard/WizardForm.h"

#include <QScreen>

#include "app/desktop/Icons.h"
#include "app/dialogs/wizard/WizardPages.h"

using namespace Qt::StringLiterals;

TWizardForm::TWizardForm(const WizardChoice& start, QWidget* parent) : QWizard(parent), choice_(start) {
    setObjectName(u"WizardForm"_s);
    setWindowTitle(u"Tunestead einrichten"_s);
    setOption(QWizard::NoBackButtonOnStartPage);
    setButtonText(QWizard::BackButton, u"< &Zurück"_s);
    setButtonText(QWizard::NextButton, u"&Weiter >"_s);
    setButtonText(QWizard::FinishButton, u"&Fertig"_s);
    setButtonText(QWizard::CancelButton, u"Abbrechen"_s);
    const int logo = 2 * fontMetrics().lineSpacing();
    setPixmap(QWizard::LogoPixmap, ProgramIcon().pixmap(logo));
    addPage(new WelcomeSheet(choice_));
    addPage(new FoldersSheet(choice_));
    addPage(new RenameSheet(choice_));
    addPage(new FinishSheet(choice_));
    constexpr int kWidth = 85;   // average characters
    constexpr int kHeight = 28;  // lines
    const QSize wanted(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().lineSpacing());
    resize(wanted.boundedTo(screen()->availableSize() * 0.9));
}
