#include "app/dialogs/HandbookWindow.h"

#include <QDialog>
#include <QFile>
#include <QImage>
#include <QTextBrowser>
#include <QVBoxLayout>
#include <algorithm>

#include "app/desktop/RaiseWindow.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWidth = 110;  // of the window, in average characters
constexpr int kHeight = 40;  // lines

// Pictures of whole windows are wider than the text.
class HandbookText : public QTextBrowser {
 public:
    HandbookText(QWidget* parent, int pictureWidth) : QTextBrowser(parent), pictureWidth_(pictureWidth) {}

 protected:
    QVariant loadResource(int type, const QUrl& name) override {
        if (type != QTextDocument::ImageResource) return QTextBrowser::loadResource(type, name);
        const QImage picture(u":/handbuch/"_s + name.path());
        return picture.scaledToWidth(std::min(picture.width(), pictureWidth_), Qt::SmoothTransformation);
    }

 private:
    int pictureWidth_;
};

QDialog* MakeWindow(QWidget& parent) {
    auto* window = new QDialog(&parent);
    window->setObjectName(u"handbook"_s);
    window->setWindowTitle(u"Handbuch"_s);
    const int width = kWidth * window->fontMetrics().averageCharWidth();
    auto* text = new HandbookText(window, width * 9 / 10);
    text->setOpenExternalLinks(true);
    QFile file(u":/handbuch/handbuch.md"_s);
    if (file.open(QIODevice::ReadOnly)) text->setMarkdown(QString::fromUtf8(file.readAll()));
    auto* layout = new QVBoxLayout(window);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(text);
    window->resize(width, kHeight * window->fontMetrics().height());
    return window;
}

}  // namespace

void ShowHandbook(QWidget& parent) {
    auto* window = parent.findChild<QDialog*>(u"handbook"_s);
    if (window == nullptr) window = MakeWindow(parent);
    window->show();
    RaiseWindow(*window, {});
}
