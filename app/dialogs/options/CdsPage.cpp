#include "app/dialogs/options/CdsPage.h"

#include <QFormLayout>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QPushButton>
#include <QTableWidget>
#include <algorithm>

#include "MusicManagment/database/MusicManagment.h"
#include "app/desktop/Icons.h"
#include "app/dialogs/TableLook.h"

using namespace Qt::StringLiterals;

namespace {

enum Column { cName, cSerial };
constexpr int kShownRows = 9;

// Also in the form "1A2B-3C4D" in which Windows shows it. 0 when it is no serial number.
quint32 SerialOf(const QString& text) {
    const QString digits = text.trimmed().remove(u'-');
    bool isNumber = false;
    const quint32 serial = digits.toUInt(&isNumber, 16);
    return isNumber && digits.size() <= 8 && !digits.startsWith(u'+') ? serial : 0;
}

QString TextAt(const QTableWidget& table, int row, int column) {
    return table.item(row, column)->text().trimmed();
}

}  // namespace

CdsPage::CdsPage()
    : OptionsPage(u"CDs"_s, ThemeIcon(u"media-optical"_s, QStyle::SP_DriveCDIcon)),
      table_(new QTableWidget(0, 2)) {
    QFormLayout& group = AddGroup(u"Namen der CDs"_s);
    AddWide(
        group, u"CDNames"_s, u"&CDs und ihre Seriennummern"_s, table_,
        u"Die Seriennummer des Datenträgers, hexadezimal wie 1A2B3C4D, wie sie auch im Pfad der Songs auf "
        "dieser CD steht"_s);
    SetTableLook(*table_, {u"Name"_s, u"Seriennummer"_s}, kShownRows);
    table_->horizontalHeader()->setStretchLastSection(false);
    table_->horizontalHeader()->setSectionResizeMode(cName, QHeaderView::Stretch);
    AddButtons(group);
    connect(table_, &QTableWidget::currentCellChanged, this, [this] { EnableButtons(); });
}

void CdsPage::AddButtons(QFormLayout& group) {
    auto* add = new QPushButton(ThemeIcon(u"list-add"_s, QStyle::SP_FileIcon), u"&Hinzufügen"_s);
    rename_ = new QPushButton(ThemeIcon(u"edit-rename"_s, QStyle::SP_FileIcon), u"&Umbenennen"_s);
    remove_ = new QPushButton(ThemeIcon(u"list-remove"_s, QStyle::SP_TrashIcon), u"&Entfernen"_s);
    add->setObjectName(u"addCd"_s);
    rename_->setObjectName(u"renameCd"_s);
    remove_->setObjectName(u"removeCd"_s);
    auto* row = new QHBoxLayout;
    for (QPushButton* button : {add, rename_, remove_})
        row->addWidget(button);
    row->addStretch();
    group.addRow(row);
    connect(add, &QPushButton::clicked, this, [this] { Add(); });
    connect(rename_, &QPushButton::clicked, this, [this] { Rename(); });
    connect(remove_, &QPushButton::clicked, this, [this] { Remove(); });
}

void CdsPage::Load(const TMusicDatabase& database, const TRWReg&) {
    table_->setRowCount(0);
    for (const CdName& cd : database.CDNames())
        AddCd(cd);
    if (table_->rowCount() > 0) table_->setCurrentCell(0, cName);
    EnableButtons();
}

std::optional<OptionsFault> CdsPage::Check() {
    for (int row = 0; row < table_->rowCount(); ++row) {
        int column = cName;
        const auto fault = FaultOfRow(row, column);
        if (!fault) continue;
        table_->setCurrentCell(row, column);
        return OptionsFault{*fault, table_};
    }
    return std::nullopt;
}

std::optional<QString> CdsPage::FaultOfRow(int row, int& column) const {
    const QString name = TextAt(*table_, row, cName);
    const QString text = TextAt(*table_, row, cSerial);
    const quint32 serial = SerialOf(text);
    column = cName;
    if (name.isEmpty()) return u"Der Name der CD in Zeile %1 fehlt."_s.arg(row + 1);
    column = cSerial;
    if (text.isEmpty()) return u"Die Seriennummer der CD „"_s + name + u"“ fehlt."_s;
    if (serial == 0)
        return u"„"_s + text + u"“ ist keine Seriennummer: erwartet werden bis zu 8 hexadezimale Ziffern."_s;
    for (int other = 0; other < row; ++other)
        if (SerialOf(TextAt(*table_, other, cSerial)) == serial)
            return u"Die CDs „"_s + TextAt(*table_, other, cName) + u"“ und „"_s + name +
                   u"“ haben dieselbe Seriennummer."_s;
    return std::nullopt;
}

void CdsPage::Apply(TMusicDatabase& database, TRWReg&) {
    std::vector<CdName> cds;
    cds.reserve(static_cast<std::size_t>(table_->rowCount()));
    for (int row = 0; row < table_->rowCount(); ++row)
        cds.push_back({TextAt(*table_, row, cName), SerialOf(TextAt(*table_, row, cSerial))});
    database.SetCDNames(std::move(cds));
}

// --- Buttons ---

void CdsPage::AddCd(const CdName& cd) {
    const int row = table_->rowCount();
    table_->insertRow(row);
    table_->setItem(row, cName, new QTableWidgetItem(cd.Name));
    table_->setItem(row, cSerial, new QTableWidgetItem(cd.Serial != 0 ? SerialText(cd.Serial) : QString()));
}

void CdsPage::Add() {
    AddCd({});
    table_->setCurrentCell(table_->rowCount() - 1, cName);
    Rename();
}

void CdsPage::Rename() {
    table_->setFocus();
    table_->setCurrentCell(table_->currentRow(), cName);
    table_->editItem(table_->currentItem());
}

void CdsPage::Remove() {
    table_->removeRow(table_->currentRow());
    EnableButtons();
}

void CdsPage::EnableButtons() {
    const bool chosen = table_->currentRow() >= 0;
    rename_->setEnabled(chosen);
    remove_->setEnabled(chosen);
}
