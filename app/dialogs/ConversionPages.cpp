#include "app/dialogs/ConversionPages.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>
#include <QSpinBox>
#include <vector>

using namespace Qt::StringLiterals;

namespace {

struct Choice {
    QString Text;
    int Value;
};

template <typename Field>
Field* AddField(QFormLayout& form, const QString& name, const QString& caption, Field* field) {
    field->setObjectName(name);
    field->setAccessibleName(QString(caption).remove(u'&'));
    form.addRow(caption + u':', field);
    return field;
}

// A value that is none of the choices was stored by somebody, and stays one.
QComboBox* AddChoice(QFormLayout& form, const QString& name, const QString& caption,
                     const std::vector<Choice>& choices, int current, const QString& unit = {}) {
    auto* box = AddField(form, name, caption, new QComboBox);
    for (const Choice& choice : choices)
        box->addItem(choice.Text, choice.Value);
    if (box->findData(current) < 0) box->addItem(QString::number(current) + unit, current);
    box->setCurrentIndex(box->findData(current));
    return box;
}

template <typename T = int>
T ValueOf(const QComboBox* box) {
    return static_cast<T>(box->currentData().toInt());
}

QComboBox* AddRate(QFormLayout& form, int current) {
    std::vector<Choice> choices = {{u"wie die Quelle"_s, 0}};
    for (const int rate : kRatesToChoose)
        choices.push_back({QString::number(rate) + u" Hz"_s, rate});
    return AddChoice(form, u"rate"_s, u"&Abtastrate"_s, choices, current, u" Hz"_s);
}

QComboBox* AddBitRate(QFormLayout& form, int current) {
    std::vector<Choice> choices;
    for (const int rate : kBitRatesToChoose)
        choices.push_back({QString::number(rate) + u" kbit/s"_s, rate});
    return AddChoice(form, u"bitRate"_s, u"&Bitrate"_s, choices, current, u" kbit/s"_s);
}

std::vector<Choice> Qualities() {
    constexpr int kUsualRates[] = {245, 225, 190, 175, 165, 130, 115, 100, 85, 65};  // kbit/s of stereo music
    std::vector<Choice> choices;
    choices.reserve(std::size(kUsualRates));
    for (const int rate : kUsualRates) {
        const int quality = static_cast<int>(choices.size());
        choices.push_back({u"V%1 (etwa %2 kbit/s)"_s.arg(quality).arg(rate), quality});
    }
    return choices;
}

}  // namespace

// --- MP3 ---

Mp3Page::Mp3Page(const Mp3Settings& settings, QWidget* parent) : QWidget(parent) {
    using Method = Mp3Settings::Method;
    using Channels = Mp3Settings::Channels;
    const auto number = [](auto value) { return static_cast<int>(value); };
    auto* form = new QFormLayout(this);
    method_ = AddChoice(*form, u"method"_s, u"&Verfahren"_s,
                        {{u"variable Bitrate"_s, number(Method::Variable)},
                         {u"konstante Bitrate"_s, number(Method::Constant)},
                         {u"mittlere Bitrate"_s, number(Method::Average)}},
                        number(settings.Bits));
    quality_ = AddChoice(*form, u"quality"_s, u"&Qualität"_s, Qualities(), settings.Quality);
    bitRate_ = AddBitRate(*form, settings.BitRate);
    sides_ = AddChoice(*form, u"sides"_s, u"Kanä&le"_s,
                       {{u"wie die Quelle"_s, number(Channels::AsSource)},
                        {u"Stereo"_s, number(Channels::Stereo)},
                        {u"Joint Stereo"_s, number(Channels::Joint)},
                        {u"Mono"_s, number(Channels::Mono)}},
                       number(settings.Sides));
    rate_ = AddRate(*form, settings.Rate);
    effort_ = AddField(*form, u"effort"_s, u"Au&fwand"_s, new QSpinBox);
    effort_->setRange(0, 9);
    effort_->setValue(settings.Effort);
    effort_->setToolTip(u"0 rechnet am längsten und klingt am besten, 9 geht am schnellsten."_s);
    connect(method_, &QComboBox::currentIndexChanged, this, [this] { EnableFields(); });
    EnableFields();
}

void Mp3Page::EnableFields() {
    const bool variable = ValueOf<Mp3Settings::Method>(method_) == Mp3Settings::Method::Variable;
    quality_->setEnabled(variable);
    bitRate_->setEnabled(!variable);
}

Mp3Settings Mp3Page::Settings() const {
    return {.Bits = ValueOf<Mp3Settings::Method>(method_),
            .Quality = ValueOf(quality_),
            .BitRate = ValueOf(bitRate_),
            .Effort = effort_->value(),
            .Sides = ValueOf<Mp3Settings::Channels>(sides_),
            .Rate = ValueOf(rate_)};
}

// --- WAV ---

WavPage::WavPage(const WavSettings& settings, QWidget* parent) : QWidget(parent) {
    using Channels = WavSettings::Channels;
    const auto number = [](Channels value) { return static_cast<int>(value); };
    auto* form = new QFormLayout(this);
    bits_ = AddChoice(*form, u"bits"_s, u"&Bit je Sample"_s, {{u"16 Bit"_s, 16}, {u"24 Bit"_s, 24}},
                      settings.Bits);
    sides_ = AddChoice(*form, u"sides"_s, u"Kanä&le"_s,
                       {{u"wie die Quelle"_s, number(Channels::AsSource)},
                        {u"Stereo"_s, number(Channels::Stereo)},
                        {u"Mono"_s, number(Channels::Mono)}},
                       number(settings.Sides));
    rate_ = AddRate(*form, settings.Rate);
    dither_ = new QCheckBox(u"Beim Kürzen auf 16 Bit d&ithern"_s);
    dither_->setObjectName(u"dither"_s);
    dither_->setToolTip(
        u"Ein leises Rauschen statt der Verzerrung leiser Töne. Was schon 16 Bit hat, bleibt, "
        "wie es ist."_s);
    dither_->setChecked(settings.Dither);
    form->addRow(dither_);
}

WavSettings WavPage::Settings() const {
    return {.Bits = ValueOf(bits_),
            .Sides = ValueOf<WavSettings::Channels>(sides_),
            .Rate = ValueOf(rate_),
            .Dither = dither_->isChecked()};
}

// --- WMA ---

WmaPage::WmaPage(const WmaSettings& settings, QWidget* parent) : QWidget(parent) {
    auto* form = new QFormLayout(this);
    bitRate_ = AddBitRate(*form, settings.BitRate);
    rate_ = AddRate(*form, settings.Rate);
    minutes_ = AddField(*form, u"minutes"_s, u"&Zeitgrenze je Song"_s, new QSpinBox);
    minutes_->setRange(1, 1000);
    minutes_->setSuffix(u" min"_s);
    minutes_->setValue(static_cast<int>(std::chrono::ceil<std::chrono::minutes>(settings.TimeLimit).count()));
    minutes_->setToolTip(u"Danach wird das Encoder-Skript beendet. Es steht in den Einstellungen."_s);
}

WmaSettings WmaPage::Settings() const {
    return {.BitRate = ValueOf(bitRate_),
            .Rate = ValueOf(rate_),
            .TimeLimit = std::chrono::minutes(minutes_->value())};
}
