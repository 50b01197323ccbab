#include "control/SettingsPersistence.h"

#include "platform/Paths.h"
#include "platform/SettingsStore.h"

namespace zorbin {
namespace {

QString number(int i)
{
    return QString::number(i);
}

} // namespace

std::vector<StoredSetting> catalogSettingsTable(CatalogSettings &s)
{
    using P = ControlProperty;
    const QString zero = QStringLiteral("0");
    const QString empty;
    std::vector<StoredSetting> table = {
        {QStringLiteral("UseCatCode"), P::check(s.ChkCatCode), zero},
        {QStringLiteral("FromSort"), P::text(s.txtFromSort), empty},
        {QStringLiteral("ToSort"), P::text(s.txtToSort), empty},
        {QStringLiteral("UseFilter"), P::check(s.chkFilter), zero},
    };
    for (int position = 1; position <= StoredCutOffPositions; ++position)
        table.push_back({QStringLiteral("CutOff") + number(position),
                         P::text(s.ItemCutOff[static_cast<std::size_t>(position - 1)]), QStringLiteral("*")});
    table.insert(table.end(), {
        {QStringLiteral("UseItemKey"), P::check(s.ChkItemKey), zero},
        {QStringLiteral("FromItem"), P::text(s.txtFromItem), empty},
        {QStringLiteral("ToItem"), P::text(s.txtToItem), empty},
        {QStringLiteral("SortBy"), P::listIndex(s.CmbSortBy), zero},
        {QStringLiteral("SortDir"), P::listIndex(s.CmbSortDir), zero},
        {QStringLiteral("PicSource0"), P::option(s.OptPicSource, 0), QStringLiteral("-1")},
        {QStringLiteral("PicSource1"), P::option(s.OptPicSource, 1), zero},
        {QStringLiteral("PicSource2"), P::option(s.OptPicSource, 2), zero},
        {QStringLiteral("PicExtraNote"), P::listIndex(s.cmbPicExtraNote), zero},
        {QStringLiteral("PicExtension"), P::text(s.txtPicExtension), QStringLiteral(".JPG")},
        {QStringLiteral("PicPath"), P::text(s.txtPicPath), defaultPictureFolder()},
        {QStringLiteral("ItemNameType"), P::listIndex(s.CmbItemNameType), zero},
        {QStringLiteral("UsePriceField"), P::check(s.chkUsePriceField), zero},
        {QStringLiteral("UsePriceField2"), P::check(s.ChkUsePriceField2), zero},
        {QStringLiteral("PriceField"), P::listIndex(s.cmbPriceField), zero},
        {QStringLiteral("PriceField2"), P::listIndex(s.cmbPriceField2), zero},
        {QStringLiteral("UseExtraNote1"), P::check(s.ChkUseExtraNote1), zero},
        {QStringLiteral("UseExtraNote2"), P::check(s.ChkUseExtraNote2), zero},
        {QStringLiteral("ExtraNote1"), P::listIndex(s.cmbExtraNote1), zero},
        {QStringLiteral("ExtraNote2"), P::listIndex(s.cmbExtraNote2), zero},
    });
    for (int i = 0; i < CellLineCount; ++i) {
        CellLine &line = s.lines[static_cast<std::size_t>(i)];
        table.push_back({QStringLiteral("LineCaption") + number(i), P::text(line.caption), empty});
        table.push_back({QStringLiteral("LineTag") + number(i), P::tag(line.tag), empty});
    }
    table.insert(table.end(), {
        {QStringLiteral("Rows"), P::text(s.txtRows), QStringLiteral("8")},
        {QStringLiteral("Cols"), P::text(s.txtCols), QStringLiteral("3")},
        {QStringLiteral("PicLocation"), P::listIndex(s.cmbPicLocation), zero},
        {QStringLiteral("PageSplit"), P::listIndex(s.cmbPageSplit), zero},
        {QStringLiteral("Rules"), P::check(s.chkRules), zero},
        {QStringLiteral("TopTitle"), P::text(s.txtTopTitle), QStringLiteral("קטלוג פריטים")},
        {QStringLiteral("TopTitle2"), P::text(s.txtTopTitle2), QStringLiteral("טרניק מערכות מידע")},
        {QStringLiteral("BottomTitle"), P::text(s.txtBottomTitle), QStringLiteral("טלפון: 03-6123456")},
        {QStringLiteral("Logo"), P::text(s.txtLogo), empty},
        {QStringLiteral("PagingPath"), P::text(s.txtPagingPath), defaultOutputFolder()},
        {QStringLiteral("TopPercent"), P::text(s.txtTopPercent), QStringLiteral("10")},
        {QStringLiteral("BottomPercent"), P::text(s.txtBottomPercent), QStringLiteral("10")},
        {QStringLiteral("ImageH"), P::text(s.txtImageH), empty},
        {QStringLiteral("ImageW"), P::text(s.txtImageW), empty},
    });
    return table;
}

std::vector<StoredSetting> cellFormatTable(CellLines &lines)
{
    using P = ControlProperty;
    std::vector<StoredSetting> table;
    for (int i = 0; i < CellLineCount; ++i) {
        CellFormat &format = lines[static_cast<std::size_t>(i)].format;
        table.push_back({QStringLiteral("Font") + number(i), P::byte(format.font), QStringLiteral("0")});
        table.push_back({QStringLiteral("Size") + number(i), P::byte(format.size), QStringLiteral("9")});
        table.push_back({QStringLiteral("Weight") + number(i), P::byte(format.weight), QStringLiteral("0")});
        table.push_back({QStringLiteral("UL") + number(i), P::byte(format.underline), QStringLiteral("0")});
        table.push_back({QStringLiteral("Italic") + number(i), P::byte(format.italic), QStringLiteral("0")});
        table.push_back({QStringLiteral("Align") + number(i), P::byte(format.align), QStringLiteral("0")});
    }
    return table;
}

bool SetGetRegControlValue(std::uint8_t action, SettingsStore &store, const QString &app, const QString &section,
                           const QString &key, const ControlProperty &property, const QString &fallback)
{
    if (action == SaveAction) {
        store.write(app, section, key, property.storeText());
        return true;
    }
    if (action == LoadAction)
        return property.apply(store.read(app, section, key, fallback));
    return true;
}

SettingsPersistence::SettingsPersistence(SettingsStore &store, CatalogSettings &settings)
    : m_store(store), m_settings(settings)
{
}

void SettingsPersistence::persist(std::uint8_t action, const QString &app, const QString &section,
                                  const StoredSetting &setting)
{
    const QString &key = setting.key;
    if (action == SaveAction) {
        const auto refused = m_unapplied.constFind(key);
        if (refused != m_unapplied.constEnd() && *refused == setting.property.storeText())
            return;  // the user never saw the stored value, so saving must not replace it
        m_unapplied.remove(key);
    } else if (action == LoadAction) {
        const QString before = setting.property.storeText();
        if (!SetGetRegControlValue(action, m_store, app, section, key, setting.property, setting.fallback))
            m_unapplied.insert(key, before);
        else
            m_unapplied.remove(key);
        return;
    }
    SetGetRegControlValue(action, m_store, app, section, key, setting.property, setting.fallback);
}

void SettingsPersistence::SetGetRegParams(std::uint8_t action)
{
    for (const StoredSetting &setting : catalogSettingsTable(m_settings))
        persist(action, StoreApp, StoreSection, setting);
}

void SettingsPersistence::GetSetFormLabDefs(std::uint8_t action, const QString &app, const QString &section)
{
    for (const StoredSetting &setting : cellFormatTable(m_settings.lines))
        persist(action, app, section, setting);
}

void SettingsPersistence::CmdDef_Click()
{
    SetGetRegParams(SaveAction);
    GetSetFormLabDefs(SaveAction, StoreApp, StoreSection);
}

QStringList SettingsPersistence::unappliedKeys() const
{
    QStringList keys = m_unapplied.keys();
    keys.sort();
    return keys;
}

} // namespace zorbin
