#include "MusicManagment/database/songfiles/NameMatch.h"

#include <QHash>
#include <algorithm>
#include <limits>

#include "CommonRUKTools/FileNames.h"
#include "MusicManagment/database/songfiles/NamePattern.h"
#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

using Id = SongFieldId;

constexpr struct {
    const char16_t* Name;
    SongFieldId Field;
} kFilled[] = {
    {u"%TITLE%", Id::Title},   {u"%ARTIST%", Id::Artist},       {u"%ALBUM%", Id::Album},
    {u"%YEAR%", Id::Year},     {u"%COMMENT%", Id::Comment},     {u"%ID3GENRE%", Id::Genre},
    {u"%TRACKNR%", Id::Track}, {u"%MAINGENRE%", Id::MainGenre},
};

constexpr QStringView kTooMany = u"Der Name lässt sich auf zu viele Arten teilen";

std::optional<SongFieldId> FieldFilledBy(const QString& placeholder) {
    for (const auto& row : kFilled)
        if (placeholder == QStringView(row.Name)) return row.Field;
    return std::nullopt;
}

// --- What a field takes of a name ---

using Names = QHash<QString, QString>;

// How a name of the tables is found again in the name of a file.
QString NameKey(const QString& name) {
    return MakeValidFileName(name).toCaseFolded();
}

const Names& GenreNames() {
    static const Names names = [] {
        Names all{{NameKey(GenreName(kNoGenre)), QString()}};
        for (const GenreRow& row : GenreTable()) {
            const QString name = QString::fromUtf16(row.Name);
            all.insert(NameKey(name), name);
        }
        all.insert(NameKey(u"Unbekannt"_s), QString());
        return all;
    }();
    return names;
}

const Names& MainGenreNames() {
    static const Names names = [] {
        Names all{{NameKey(MainGenreLongName(0)), QString()}};
        for (int index = 1; index < kMainGenreCount; ++index)
            for (const QString& name : {MainGenreLongName(index), MainGenreName(index)})
                all.insert(NameKey(name), MainGenreLongName(index));
        return all;
    }();
    return names;
}

std::optional<QString> NameIn(const Names& names, const QString& text) {
    const auto found = names.find(NameKey(text));
    return found == names.end() ? std::nullopt : std::optional(*found);
}

bool IsDigits(const QString& text) {
    return std::ranges::all_of(text, [](QChar c) { return c >= u'0' && c <= u'9'; });
}

std::optional<QString> TrackIn(const QString& text) {
    constexpr int kMost = std::numeric_limits<quint8>::max();
    if (!IsDigits(text)) return std::nullopt;
    bool isNumber = false;
    const int number = text.toInt(&isNumber);
    if (!isNumber || number > kMost) return std::nullopt;
    return number == 0 ? QString() : QString::number(number);
}

std::optional<QString> YearIn(const QString& text) {
    if (text.size() != 4 || !IsDigits(text)) return std::nullopt;
    return text == u"0000" ? QString() : text;
}

// What is entered there, empty where the name says nothing of it; nothing at all where the field cannot hold
// what the name says.
std::optional<QString> EnteredIn(SongFieldId field, const QString& text) {
    const QString trimmed = text.trimmed();
    if (trimmed.isEmpty()) return QString();
    switch (field) {
        case Id::Year:
            return YearIn(trimmed);
        case Id::Track:
            return TrackIn(trimmed);
        case Id::Genre:
            return NameIn(GenreNames(), trimmed);
        case Id::MainGenre:
            return NameIn(MainGenreNames(), trimmed);
        default:
            return trimmed;
    }
}

}  // namespace

// --- The pattern ---

NameMatcher::NameMatcher(const QString& pattern) {
    Divide(pattern.normalized(QString::NormalizationForm_C));
    fault_ = FaultOfParts();
}

void NameMatcher::Divide(const QString& pattern) {
    const QStringList names = NamePatternPlaceholders();
    for (qsizetype at = 0; at < pattern.size();) {
        const auto name = std::ranges::find_if(
            names, [&](const QString& each) { return QStringView(pattern).sliced(at).startsWith(each); });
        if (name != names.end()) {
            AddPlaceholder(*name);
            at += name->size();
        } else {
            AddText(pattern[at++]);
        }
    }
}

void NameMatcher::AddPlaceholder(const QString& name) {
    const auto known = std::ranges::find(placeholders_, name, &Placeholder::Name);
    parts_.push_back({.Number = static_cast<std::size_t>(known - placeholders_.begin())});
    if (known == placeholders_.end())
        placeholders_.push_back({name, FieldFilledBy(name)});
    else
        known->Recurs = true;
}

void NameMatcher::AddText(QChar character) {
    const bool isSeparator = character == u'/' || character == u'\\';
    // In front there is nothing to separate: the names of the folders above do not matter.
    if (isSeparator && parts_.empty()) return;
    if (parts_.empty() || parts_.back().Number) parts_.emplace_back();
    parts_.back().Text += isSeparator ? QChar(u'/') : character;
    if (isSeparator) ++folders_;
}

QString NameMatcher::FaultOfParts() const {
    for (std::size_t i = 1; i < parts_.size(); ++i)
        if (parts_[i - 1].Number && parts_[i].Number)
            return u"Zwischen %1 und %2 muss ein Text stehen, sonst ist nicht klar, wo sich der Name teilt."_s
                .arg(placeholders_[*parts_[i - 1].Number].Name, placeholders_[*parts_[i].Number].Name);
    if (Fields().empty()) return u"Das Muster enthält keinen Platzhalter für ein Feld des Tags."_s;
    return {};
}

std::vector<SongFieldId> NameMatcher::Fields() const {
    std::vector<SongFieldId> fields;
    for (const Placeholder& placeholder : placeholders_)
        if (placeholder.Field) fields.push_back(*placeholder.Field);
    return fields;
}

// --- A name ---

// Looks for the values of the place-holders. What has failed is remembered, so that it does not matter in how
// many ways the blanks of a long name divide it. Where place-holders recur it may matter all the same: there
// the number of tries is bounded.
class NameMatcher::Walk {
 public:
    // What counts; less of it where nothing fits, to tell why.
    enum class Care { All, NoFields, NeitherFieldsNorRepeats };

    Walk(const NameMatcher& matcher, const QString& text, Care care)
        : parts_(matcher.parts_),
          placeholders_(matcher.placeholders_),
          text_(text),
          care_(care),
          values_(placeholders_.size()),
          failed_(parts_.size(), std::vector<bool>(static_cast<std::size_t>(text.size()) + 1)) {}

    bool Succeeds() { return Fits(0, 0); }
    // Whether there were more ways to divide the name than it could try.
    bool GaveUp() const { return tries_ > kMostTries; }
    // Only when it has succeeded.
    const QString& Value(std::size_t placeholder) const { return *values_[placeholder]; }

 private:
    static constexpr int kMostTries = 50'000;

    bool RepeatsCount() const { return care_ != Care::NeitherFieldsNorRepeats; }

    // Whether the text from there on is what the parts from this one on say.
    bool Fits(std::size_t part, qsizetype at) {
        if (part == parts_.size()) return at == text_.size();
        const auto place = static_cast<std::size_t>(at);
        if (failed_[part][place]) return false;
        const bool fits = PartFits(part, at);
        failed_[part][place] = !fits;
        return fits;
    }

    bool PartFits(std::size_t part, qsizetype at) {
        const auto number = parts_[part].Number;
        if (!number) return TextFits(part, parts_[part].Text, at);
        const bool stoodBefore = values_[*number] && RepeatsCount();
        return stoodBefore ? TextFits(part, *values_[*number], at) : ValueFits(part, *number, at);
    }

    bool TextFits(std::size_t part, const QString& text, qsizetype at) {
        return QStringView(text_).sliced(at).startsWith(text) && Fits(part + 1, at + text.size());
    }

    bool ValueFits(std::size_t part, std::size_t number, qsizetype at) {
        const auto& field = placeholders_[number].Field;
        const qsizetype separator = text_.indexOf(u'/', at);
        const qsizetype last = separator < 0 ? text_.size() : separator;
        for (qsizetype end = EndFrom(part, at); end >= 0 && end <= last; end = EndFrom(part, end + 1)) {
            if (++tries_ > kMostTries) break;
            const QString value = text_.mid(at, end - at);
            if (care_ == Care::All && field && !EnteredIn(*field, value)) continue;
            values_[number] = value;
            if (placeholders_[number].Recurs && RepeatsCount()) ForgetBehind(part);
            if (Fits(part + 1, end)) return true;
        }
        values_[number].reset();
        return false;
    }

    // Where a value may end, from there on; -1 for nowhere. Behind it stands a text, or nothing.
    qsizetype EndFrom(std::size_t part, qsizetype from) const {
        if (from > text_.size()) return -1;
        return part + 1 == parts_.size() ? text_.size() : text_.indexOf(parts_[part + 1].Text, from);
    }

    // With another value of this one, what failed may fit.
    void ForgetBehind(std::size_t part) {
        for (std::size_t later = part + 1; later < failed_.size(); ++later)
            failed_[later].assign(failed_[later].size(), false);
    }

    const std::vector<Part>& parts_;
    const std::vector<Placeholder>& placeholders_;
    const QString& text_;
    Care care_;
    std::vector<std::optional<QString>> values_;  // one for each place-holder; nothing while it is open
    std::vector<std::vector<bool>> failed_;
    int tries_ = 0;
};

// The part of the path that the pattern is about.
QString NameMatcher::TextOf(const QString& path) const {
    const qsizetype dot = path.lastIndexOf(u'.');
    QString text = dot > LastSeparator(path) + 1 ? path.left(dot) : path;
    if (IsCdPath(text)) text = text.mid(text.indexOf(u':', 1) + 1).replace(u'\\', u'/');
    return text.section(u'/', -1 - folders_).normalized(QString::NormalizationForm_C);
}

NameReading NameMatcher::Read(const QString& path) const {
    const QString text = TextOf(path);
    Walk walk(*this, text, Walk::Care::All);
    if (!walk.Succeeds()) return {.Problem = walk.GaveUp() ? kTooMany.toString() : ProblemOf(text)};
    NameReading reading;
    for (std::size_t i = 0; i < placeholders_.size(); ++i) {
        const auto& field = placeholders_[i].Field;
        if (!field) continue;
        const auto entered = EnteredIn(*field, walk.Value(i));
        if (entered && !entered->isEmpty()) reading.Fields.push_back({*field, *entered});
    }
    return reading;
}

QString NameMatcher::ProblemOf(const QString& text) const {
    Walk anyValues(*this, text, Walk::Care::NoFields);
    if (anyValues.Succeeds())
        for (std::size_t i = 0; i < placeholders_.size(); ++i) {
            const auto& id = placeholders_[i].Field;
            if (!id || EnteredIn(*id, anyValues.Value(i))) continue;
            const SongField& field = FieldOf(*id);
            return u"%1 erwartet %2, nicht „%3“"_s.arg(field.Caption, field.Accepts,
                                                       anyValues.Value(i).trimmed());
        }
    if (anyValues.GaveUp()) return kTooMany.toString();
    if (Walk(*this, text, Walk::Care::NeitherFieldsNorRepeats).Succeeds())
        return u"Der Name sagt zu demselben Platzhalter Verschiedenes"_s;
    return u"Passt nicht zum Muster"_s;
}

TID3Tag WithNamedFields(TID3Tag record, const NameReading& reading) {
    for (const NamedField& named : reading.Fields)
        FieldOf(named.Field).Set(record, named.Text);
    return record;
}
