#include "model/SettingsPersistence.h"

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
    std::vector<StoredSetting> table;
    auto add = [&table](QString key, ControlProperty property, QString fallback) {
        table.push_back({std::move(key), std::move(property), std::move(fallback)});
    };
    add(QStringLiteral("UseCatCode"), P::check(s.ChkCatCode), zero);
    add(QStringLiteral("FromSort"), P::text(s.txtFromSort), empty);
    add(QStringLiteral("ToSort"), P::text(s.txtToSort), empty);
    add(QStringLiteral("UseFilter"), P::check(s.chkFilter), zero);
    for (int position = 1; position <= StoredCutOffPositions; ++position)
        add(QStringLiteral("CutOff") + number(position),
            P::text(s.ItemCutOff[static_cast<std::size_t>(position - 1)]), QStringLiteral("*"));
    add(QStringLiteral("UseItemKey"), P::check(s.ChkItemKey), zero);
    add(QStringLiteral("FromItem"), P::text(s.txtFromItem), empty);
    add(QStringLiteral("ToItem"), P::text(s.txtToItem), empty);
    add(QStringLiteral("SortBy"), P::listIndex(s.CmbSortBy), zero);
    add(QStringLiteral("SortDir"), P::listIndex(s.CmbSortDir), zero);
    add(QStringLiteral("PicSource0"), P::option(s.OptPicSource, 0), QStringLiteral("-1"));
    add(QStringLiteral("PicSource1"), P::option(s.OptPicSource, 1), zero);
    add(QStringLiteral("PicSource2"), P::option(s.OptPicSource, 2), zero);
    add(QStringLiteral("PicExtraNote"), P::listIndex(s.cmbPicExtraNote), zero);
    add(QStringLiteral("PicExtension"), P::text(s.txtPicExtension), QStringLiteral(".JPG"));
    add(QStringLiteral("PicPath"), P::text(s.txtPicPath), defaultPictureFolder());
    add(QStringLiteral("ItemNameType"), P::listIndex(s.CmbItemNameType), zero);
    add(QStringLiteral("UsePriceField"), P::check(s.chkUsePriceField), zero);
    add(QStringLiteral("UsePriceField2"), P::check(s.ChkUsePriceField2), zero);
    add(QStringLiteral("PriceField"), P::listIndex(s.cmbPriceField), zero);
    add(QStringLiteral("PriceField2"), P::listIndex(s.cmbPriceField2), zero);
    add(QStringLiteral("UseExtraNote1"), P::check(s.ChkUseExtraNote1), zero);
    add(QStringLiteral("UseExtraNote2"), P::check(s.ChkUseExtraNote2), zero);
    add(QStringLiteral("ExtraNote1"), P::listIndex(s.cmbExtraNote1), zero);
    add(QStringLiteral("ExtraNote2"), P::listIndex(s.cmbExtraNote2), zero);
    for (int i = 0; i < CellLineCount; ++i) {
        CellLine &line = s.lines[static_cast<std::size_t>(i)];
        add(QStringLiteral("LineCaption") + number(i), P::text(line.caption), empty);
        add(QStringLiteral("LineTag") + number(i), P::tag(line.tag), empty);
    }
    add(QStringLiteral("Rows"), P::text(s.txtRows), QStringLiteral("8"));
    add(QStringLiteral("Cols"), P::text(s.txtCols), QStringLiteral("3"));
    add(QStringLiteral("PicLocation"), P::listIndex(s.cmbPicLocation), zero);
    add(QStringLiteral("PageSplit"), P::listIndex(s.cmbPageSplit), zero);
    add(QStringLiteral("Rules"), P::check(s.chkRules), zero);
    add(QStringLiteral("TopTitle"), P::text(s.txtTopTitle), QStringLiteral("קטלוג פריטים"));
    add(QStringLiteral("TopTitle2"), P::text(s.txtTopTitle2), QStringLiteral("טרניק מערכות מידע"));
    add(QStringLiteral("BottomTitle"), P::text(s.txtBottomTitle), QStringLiteral("טלפון: 03-6123456"));
    add(QStringLiteral("Logo"), P::text(s.txtLogo), empty);
    add(QStringLiteral("PagingPath"), P::text(s.txtPagingPath), defaultOutputFolder());
    add(QStringLiteral("TopPercent"), P::text(s.txtTopPercent), QStringLiteral("10"));
    add(QStringLiteral("BottomPercent"), P::text(s.txtBottomPercent), QStringLiteral("10"));
    add(QStringLiteral("ImageH"), P::text(s.txtImageH), empty);
    add(QStringLiteral("ImageW"), P::text(s.txtImageW), empty);
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

bool SetGetRegControlValue(std::uint8_t action, SettingsStore &store, const QString &app,
                           const QString &section, const QString &key, const ControlProperty &property,
                           const QString &fallback)
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
{}

void SettingsPersistence::persist(std::uint8_t action, const QString &app, const QString &section,
                                  const StoredSetting &setting)
{
    const QString &key = setting.key;
    if (action == SaveAction) {
        const auto refused = m_unapplied.constFind(key);
        if (refused != m_unapplied.constEnd() && *refused == setting.property.storeText())
            return; // the user never saw the stored value, so saving must not replace it
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
    m_store.flush();
}

QStringList SettingsPersistence::unappliedKeys() const
{
    QStringList keys = m_unapplied.keys();
    keys.sort();
    return keys;
}

} // namespace zorbin
