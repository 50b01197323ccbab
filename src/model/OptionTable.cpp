#include "model/OptionTable.h"

#include "common/Numbers.h"
#include "model/CatalogSettings.h"
#include "platform/Paths.h"

#include <limits>

namespace zorbin {
namespace {

constexpr int Int16Lowest = std::numeric_limits<std::int16_t>::min();
constexpr int Int16Highest = std::numeric_limits<std::int16_t>::max();
constexpr int IntLowest = std::numeric_limits<int>::min();
constexpr int IntHighest = std::numeric_limits<int>::max();

QString number(int value)
{
    return QString::number(value);
}

// Each option is reached through `get`, a function from a record to the option's member that
// serves a const record and a changeable one alike.

template <typename Get> StoredOption textOption(QString key, QString defaultText, Get get)
{
    return {std::move(key), PropertyKind::Text, std::move(defaultText),
            [get](const CatalogSettings &s) { return get(s); },
            [get](CatalogSettings &s, const QString &text) {
                get(s) = text;
                return true;
            }};
}

// A check box: "1" ticked, "0" not; a grey box ("2") counts as not ticked.
template <typename Get>
StoredOption flagOption(QString key, Get get, QString defaultText = QStringLiteral("0"))
{
    return {std::move(key), PropertyKind::Value, std::move(defaultText),
            [get](const CatalogSettings &s) { return get(s) ? QStringLiteral("1") : QStringLiteral("0"); },
            [get](CatalogSettings &s, const QString &text) {
                const auto value = toInt16(text);
                if (!value || *value < 0 || *value > 2)
                    return false;
                get(s) = *value == 1;
                return true;
            }};
}

// A list of fixed entries: the entry's index, "-1" for none.
template <typename Enum, typename Get> StoredOption choiceOption(QString key, int entries, Get get)
{
    return {std::move(key), PropertyKind::ListIndex, QStringLiteral("0"),
            [get](const CatalogSettings &s) {
                const std::optional<Enum> &choice = get(s);
                return choice ? number(static_cast<int>(*choice)) : QStringLiteral("-1");
            },
            [get, entries](CatalogSettings &s, const QString &text) {
                const auto index = toInt16(text);
                if (!index || *index < -1 || *index >= entries)
                    return false;
                get(s) = *index == -1 ? std::nullopt : std::optional<Enum>(static_cast<Enum>(*index));
                return true;
            }};
}

// A list filled from the accounting database: the selected entry's index, "-1" for none.
template <typename Get> StoredOption listOption(QString key, Get get)
{
    return {std::move(key), PropertyKind::ListIndex, QStringLiteral("0"),
            [get](const CatalogSettings &s) { return number(get(s).currentIndex()); },
            [get](CatalogSettings &s, const QString &text) {
                const auto index = toInt16(text);
                return index && get(s).setCurrentIndex(*index);
            }};
}

// A number box; any text applies, one that is no whole number of the range as an empty option.
template <typename Get>
StoredOption numberOption(QString key, QString defaultText, int lowest, int highest, Get get)
{
    return {std::move(key), PropertyKind::Text, std::move(defaultText),
            [get](const CatalogSettings &s) { return numberStoreText(get(s)); },
            [get, lowest, highest](CatalogSettings &s, const QString &text) {
                get(s) = numberFromText(text, lowest, highest);
                return true;
            }};
}

// One of the three option buttons of the picture source, each stored under a key of its own.
StoredOption pictureSourceButton(int index)
{
    const auto source = static_cast<PictureSource>(index);
    return {QStringLiteral("PicSource") + number(index), PropertyKind::Value,
            index == 0 ? QStringLiteral("-1") : QStringLiteral("0"),
            [source](const CatalogSettings &s) { return optionStoreText(s.pictureSource == source); },
            [source](CatalogSettings &s, const QString &text) {
                const auto set = optionFromStoreText(text);
                if (!set)
                    return false;
                if (*set)
                    s.pictureSource = source;
                else if (s.pictureSource == source)
                    s.pictureSource.reset();
                return true;
            }};
}

StoredOption lineTagOption(int line)
{
    const auto i = static_cast<std::size_t>(line);
    return {QStringLiteral("LineTag") + number(line), PropertyKind::Tag, QString(),
            [i](const CatalogSettings &s) {
                const std::optional<int> &field = s.lines[i].field;
                return field ? number(*field) : QString();
            },
            [i](CatalogSettings &s, const QString &text) {
                // A tag that names no field would break every run: refused like any other
                // value that its widget cannot take.
                if (text.isEmpty()) {
                    s.lines[i].field.reset();
                    return true;
                }
                const auto field = fieldOfTag(text);
                if (field)
                    s.lines[i].field = field;
                return field.has_value();
            }};
}

template <typename Get> StoredOption byteOption(QString key, QString defaultText, Get get)
{
    return {std::move(key), PropertyKind::Value, std::move(defaultText),
            [get](const CatalogSettings &s) { return number(get(s)); },
            [get](CatalogSettings &s, const QString &text) {
                const auto value = toByte(text);
                if (value)
                    get(s) = *value;
                return value.has_value();
            }};
}

std::vector<StoredOption> makeCatalogOptionTable()
{
    const QString empty;
    std::vector<StoredOption> t;
    t.push_back(flagOption(
        QStringLiteral("UseCatCode"), [](auto &s) -> auto & { return s.sortCodeRange; }));
    t.push_back(textOption(
        QStringLiteral("FromSort"), empty, [](auto &s) -> auto & { return s.sortCodeFrom; }));
    t.push_back(textOption(
        QStringLiteral("ToSort"), empty, [](auto &s) -> auto & { return s.sortCodeTo; }));
    t.push_back(flagOption(
        QStringLiteral("UseFilter"), [](auto &s) -> auto & { return s.cutOffFilter; }));
    for (int position = 1; position <= StoredCutOffPositions; ++position) {
        const auto i = static_cast<std::size_t>(position - 1);
        t.push_back(textOption(
            QStringLiteral("CutOff") + number(position),
            QStringLiteral("*"), [i](auto &s) -> auto & { return s.cutOff[i]; }));
    }
    t.push_back(flagOption(
        QStringLiteral("UseItemKey"), [](auto &s) -> auto & { return s.itemKeyRange; }));
    t.push_back(textOption(
        QStringLiteral("FromItem"), empty, [](auto &s) -> auto & { return s.itemKeyFrom; }));
    t.push_back(textOption(
        QStringLiteral("ToItem"), empty, [](auto &s) -> auto & { return s.itemKeyTo; }));
    t.push_back(choiceOption<SortKey>(
        QStringLiteral("SortBy"), 3, [](auto &s) -> auto & { return s.sortKey; }));
    t.push_back(choiceOption<SortDirection>(
        QStringLiteral("SortDir"), 2, [](auto &s) -> auto & { return s.sortDirection; }));
    for (int button = 0; button < 3; ++button)
        t.push_back(pictureSourceButton(button));
    t.push_back(listOption(
        QStringLiteral("PicExtraNote"), [](auto &s) -> auto & { return s.pictureNote; }));
    t.push_back(textOption(
        QStringLiteral("PicExtension"), QStringLiteral(".JPG"),
        [](auto &s) -> auto & { return s.pictureExtension; }));
    t.push_back(textOption(
        QStringLiteral("PicPath"), defaultPictureFolder(),
        [](auto &s) -> auto & { return s.pictureFolder; }));
    t.push_back(choiceOption<ItemNameSource>(
        QStringLiteral("ItemNameType"), 2, [](auto &s) -> auto & { return s.itemName; }));
    t.push_back(flagOption(
        QStringLiteral("UsePriceField"), [](auto &s) -> auto & { return s.collectPrice1; }));
    t.push_back(flagOption(
        QStringLiteral("UsePriceField2"), [](auto &s) -> auto & { return s.collectPrice2; }));
    t.push_back(listOption(
        QStringLiteral("PriceField"), [](auto &s) -> auto & { return s.priceList1; }));
    t.push_back(listOption(
        QStringLiteral("PriceField2"), [](auto &s) -> auto & { return s.priceList2; }));
    t.push_back(flagOption(
        QStringLiteral("UseExtraNote1"), [](auto &s) -> auto & { return s.collectNote1; }));
    t.push_back(flagOption(
        QStringLiteral("UseExtraNote2"), [](auto &s) -> auto & { return s.collectNote2; }));
    t.push_back(listOption(
        QStringLiteral("ExtraNote1"), [](auto &s) -> auto & { return s.extraNote1; }));
    t.push_back(listOption(
        QStringLiteral("ExtraNote2"), [](auto &s) -> auto & { return s.extraNote2; }));
    for (int line = 0; line < CellLineCount; ++line) {
        const auto i = static_cast<std::size_t>(line);
        t.push_back(textOption(
            QStringLiteral("LineCaption") + number(line),
            empty, [i](auto &s) -> auto & { return s.lines[i].caption; }));
        t.push_back(lineTagOption(line));
    }
    t.push_back(numberOption(
        QStringLiteral("Rows"), QStringLiteral("8"), Int16Lowest, Int16Highest,
        [](auto &s) -> auto & { return s.rows; }));
    t.push_back(numberOption(
        QStringLiteral("Cols"), QStringLiteral("3"), Int16Lowest, Int16Highest,
        [](auto &s) -> auto & { return s.columns; }));
    t.push_back(choiceOption<PictureLocation>(
        QStringLiteral("PicLocation"), 2, [](auto &s) -> auto & { return s.pictureLocation; }));
    t.push_back(choiceOption<PageSplit>(
        QStringLiteral("PageSplit"), 2, [](auto &s) -> auto & { return s.pageSplit; }));
    t.push_back(flagOption(
        QStringLiteral("Rules"), [](auto &s) -> auto & { return s.frameItems; }));
    t.push_back(textOption(
        QStringLiteral("TopTitle"), QStringLiteral("קטלוג פריטים"),
        [](auto &s) -> auto & { return s.topTitle; }));
    t.push_back(textOption(
        QStringLiteral("TopTitle2"), QStringLiteral("טרניק מערכות מידע"),
        [](auto &s) -> auto & { return s.topTitle2; }));
    // The shop completes its own telephone number.
    t.push_back(textOption(
        QStringLiteral("BottomTitle"), QStringLiteral("טלפון: "),
        [](auto &s) -> auto & { return s.bottomTitle; }));
    t.push_back(textOption(
        QStringLiteral("Logo"), empty, [](auto &s) -> auto & { return s.logo; }));
    t.push_back(textOption(
        QStringLiteral("PagingPath"), defaultOutputFolder(),
        [](auto &s) -> auto & { return s.outputFolder; }));
    t.push_back(numberOption(
        QStringLiteral("TopPercent"), QStringLiteral("10"), Int16Lowest, Int16Highest,
        [](auto &s) -> auto & { return s.topPercent; }));
    t.push_back(numberOption(
        QStringLiteral("BottomPercent"), QStringLiteral("10"), Int16Lowest, Int16Highest,
        [](auto &s) -> auto & { return s.bottomPercent; }));
    t.push_back(numberOption(
        QStringLiteral("ImageH"), empty, IntLowest, IntHighest,
        [](auto &s) -> auto & { return s.pictureHeight; }));
    t.push_back(numberOption(
        QStringLiteral("ImageW"), empty, IntLowest, IntHighest,
        [](auto &s) -> auto & { return s.pictureWidth; }));
    t.push_back(flagOption(
        QStringLiteral("WebSections"), [](auto &s) -> auto & { return s.webSections; }, QStringLiteral("1")));
    return t;
}

std::vector<StoredOption> makeCellFormatTable()
{
    std::vector<StoredOption> t;
    for (int line = 0; line < CellLineCount; ++line) {
        const auto i = static_cast<std::size_t>(line);
        const QString n = number(line);
        t.push_back(byteOption(
            QStringLiteral("Font") + n,
            QStringLiteral("0"), [i](auto &s) -> auto & { return s.lines[i].format.font; }));
        t.push_back(byteOption(
            QStringLiteral("Size") + n,
            QStringLiteral("9"), [i](auto &s) -> auto & { return s.lines[i].format.size; }));
        t.push_back(byteOption(
            QStringLiteral("Weight") + n,
            QStringLiteral("0"), [i](auto &s) -> auto & { return s.lines[i].format.weight; }));
        t.push_back(byteOption(
            QStringLiteral("UL") + n,
            QStringLiteral("0"), [i](auto &s) -> auto & { return s.lines[i].format.underline; }));
        t.push_back(byteOption(
            QStringLiteral("Italic") + n,
            QStringLiteral("0"), [i](auto &s) -> auto & { return s.lines[i].format.italic; }));
        t.push_back(byteOption(
            QStringLiteral("Align") + n,
            QStringLiteral("0"), [i](auto &s) -> auto & { return s.lines[i].format.align; }));
    }
    return t;
}

} // namespace

const std::vector<StoredOption> &catalogOptionTable()
{
    static const std::vector<StoredOption> table = makeCatalogOptionTable();
    return table;
}

const std::vector<StoredOption> &cellFormatTable()
{
    static const std::vector<StoredOption> table = makeCellFormatTable();
    return table;
}

const StoredOption *findStoredOption(const QString &key)
{
    for (const auto *table : {&catalogOptionTable(), &cellFormatTable()}) {
        for (const StoredOption &option : *table) {
            if (option.key == key)
                return &option;
        }
    }
    return nullptr;
}

QString optionStoreText(bool value)
{
    return value ? QStringLiteral("True") : QStringLiteral("False");
}

std::optional<bool> optionFromStoreText(const QString &text)
{
    const QString trimmed = text.trimmed();
    if (trimmed.compare(QLatin1String("True"), Qt::CaseInsensitive) == 0)
        return true;
    if (trimmed.compare(QLatin1String("False"), Qt::CaseInsensitive) == 0)
        return false;
    if (const auto value = parseNumber(trimmed))
        return *value != 0.0;
    return std::nullopt;
}

QString numberStoreText(const std::optional<int> &value)
{
    return value ? number(*value) : QString();
}

std::optional<int> numberFromText(const QString &text, int lowest, int highest)
{
    const auto whole = toWholeNumber(text, lowest, highest);
    if (!whole)
        return std::nullopt;
    return static_cast<int>(*whole);
}

} // namespace zorbin
