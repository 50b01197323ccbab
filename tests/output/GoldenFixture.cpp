#include "GoldenFixture.h"

#include "model/CatalogSettings.h"
#include "model/SettingsPersistence.h"
#include "platform/SettingsStore.h"
#include "testutil/TestFiles.h"
#include "testutil/WorkDatabaseFixture.h"

#include <QDir>
#include <QSettings>

namespace zorbin::test {
namespace {

const QString RootMark = QStringLiteral("{root}");
const QString SettingsName = QStringLiteral("settings.ini");

WorkItem item(const char *key, const QVariant &name, const QVariant &sort, const QVariant &unit,
              const QVariant &price, const QVariant &coin, const QVariant &picture, bool include = true)
{
    WorkItem row{QString::fromUtf8(key)};
    row.name = name;
    row.sort = sort;
    row.unit = unit;
    row.price = price;
    row.coin = coin;
    row.picture = picture;
    row.include = include;
    return row;
}

QString text(const char *utf8)
{
    return QString::fromUtf8(utf8);
}

} // namespace

QString goldenFolder()
{
    return QStringLiteral(ZORBIN_SOURCE_DIR "/tests/output/golden");
}

QStringList goldenCases()
{
    QStringList cases;
    const QDir folder(goldenFolder());
    for (const QString &name : folder.entryList(QDir::Dirs | QDir::NoDotAndDotDot, QDir::Name)) {
        if (QFileInfo::exists(folder.filePath(name + QLatin1Char('/') + SettingsName)))
            cases << name;
    }
    return cases;
}

Status makeGoldenWorkDatabase(const QString &path, const QString &root, bool noneIncluded)
{
    const QString pictures = root + QStringLiteral("/pictures/");
    const QVariant null;
    const QVariant shekel = text("ש\"ח");
    WorkRows rows;
    rows.items = {
        item("1001", text("כיסא עץ"), 10, text("יח'"), 1234.5, shekel,
             pictures + QStringLiteral("chair.png")),
        item("1002", text("שולחן אוכל"), 10, text("יח'"), 0.0, shekel,
             pictures + QStringLiteral("table.gif")),
        item("1003", text("Bolt <M8> & nut"), 20, text("pcs"), -3.0, text("$"),
             pictures + QStringLiteral("l'or & fils.jpg")),
        item("1004", text("מנורה 😀 Lamp"), 30, text("?"), 99.999, text("€"), text("?")),
        item("1005", null, null, null, null, null, null),
        item("1006", text("花瓶 vase"), 30, text("kg"), 1000000.0, text("?"),
             pictures + QStringLiteral("wide.bmp")),
        item("1007", text("ספה \"תלת\" 'מושבית'"), 40, text("יח'"), 12.3, shekel,
             pictures + QStringLiteral("missing.png")),
        item("1008", text("מוסתר"), 10, text("יח'"), 5.0, shekel, text("?"), false),
        item("A-9", text("מוסתר גם הוא"), 10, text("יח'"), 6.0, shekel, text("?"), false),
    };
    if (noneIncluded) {
        for (WorkItem &row : rows.items)
            row.include = false;
    }
    rows.other[QStringLiteral("tItemSort")] = {
        {10, text("ריהוט")},
        {20, text("ברגים & אומים")},
        {30, text("<תאורה>")},
    };
    rows.other[QStringLiteral("tItemPrice1")] = {
        {text("1001"), text("$"), 330.0},
        {text("1002"), shekel, 2500.75},
    };
    rows.other[QStringLiteral("tItemPrice2")] = {
        {text("1001"), text("$"), 300.25},
        {text("1003"), shekel, null},
        {text("1006"), null, 45.0},
    };
    rows.other[QStringLiteral("tExtraNote1")] = {
        {text("1001"), text("עץ אלון")},
        {text("1003"), text("M8 <stainless>")},
    };
    rows.other[QStringLiteral("tExtraNote2")] = {
        {text("1002"), text("https://example.com/?a=1&b=2")},
        {text("1006"), text("")},
    };
    return makeWorkDatabase(path, rows);
}

QString goldenTestValue(const QString &caseName, const QString &key)
{
    QSettings ini(goldenFolder() + QLatin1Char('/') + caseName + QLatin1Char('/') + SettingsName,
                  QSettings::IniFormat);
    return ini.value(QStringLiteral("Test/") + key).toString();
}

Status loadGoldenSettings(const QString &caseName, const QString &root, CatalogSettings &settings)
{
    const QByteArray content =
        readFile(goldenFolder() + QLatin1Char('/') + caseName + QLatin1Char('/') + SettingsName);
    if (content.isEmpty())
        return Status::fault(QStringLiteral("no settings for the case %1").arg(caseName));
    const QString copy = root + QLatin1Char('/') + SettingsName;
    writeFile(copy, QString::fromUtf8(content).replace(RootMark, root).toUtf8());
    for (ChoiceList *list : settings.sourceLists()) {
        list->clear();
        list->addEntry(text("ראשון"), 0);
        list->addEntry(text("שני"), 2);
    }
    const auto store = openIniSettingsStore(copy);
    SettingsPersistence persistence(*store, settings);
    persistence.SetGetRegParams(LoadAction);
    persistence.GetSetFormLabDefs(LoadAction, StoreApp, StoreSection);
    if (!persistence.unappliedKeys().isEmpty())
        return Status::fault(QStringLiteral("settings of %1 not applied: %2")
                                 .arg(caseName, persistence.unappliedKeys().join(QStringLiteral(", "))));
    if (goldenTestValue(caseName, QStringLiteral("OnlyWithPic")) == QLatin1String("1"))
        settings.onlyWithPicture = true;
    return Status::ok();
}

QMap<QString, QByteArray> producedFiles(const QString &folder, const QString &root)
{
    QMap<QString, QByteArray> files;
    const QDir dir(folder);
    for (const QString &name : dir.entryList(QDir::Files, QDir::Name))
        files.insert(name, readFile(dir.filePath(name)).replace(root.toUtf8(), RootMark.toUtf8()));
    return files;
}

QMap<QString, QByteArray> expectedFiles(const QString &caseName)
{
    QMap<QString, QByteArray> files;
    const QDir dir(goldenFolder() + QLatin1Char('/') + caseName);
    for (const QString &name : dir.entryList(QDir::Files, QDir::Name)) {
        if (name != SettingsName)
            files.insert(name, readFile(dir.filePath(name)));
    }
    return files;
}

} // namespace zorbin::test
