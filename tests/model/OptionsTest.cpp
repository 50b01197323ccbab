#include "model/CatalogSettings.h"
#include "model/GridSize.h"
#include "model/SettingsPersistence.h"
#include "platform/SettingsStore.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QFile>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using zorbin::test::MemorySettingsStore;

namespace {

// What the start-up's list filling leaves when the accounting database answers.
void fillSourceLists(CatalogSettings &settings)
{
    for (ChoiceList *list : {&settings.pictureNote, &settings.extraNote1, &settings.extraNote2}) {
        list->addEntry(QStringLiteral("צבע"), 1);
        list->addEntry(QStringLiteral("תמונה"), 4);
    }
    for (ChoiceList *list : {&settings.priceList1, &settings.priceList2}) {
        list->addEntry(QStringLiteral("מחיר מכירה"), 0);
        list->addEntry(QStringLiteral("סיטונאי"), 3);
        list->addEntry(QStringLiteral("קמעונאי"), 7);
    }
}

void load(SettingsPersistence &persistence)
{
    persistence.SetGetRegParams(LoadAction);
    persistence.GetSetFormLabDefs(LoadAction, StoreApp, StoreSection);
}

} // namespace

class OptionsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    // A settings file that version 1.0 saved, every key in it, loads into the options and saves
    // back byte for byte, with the one key added since: no stored value changes its text by
    // passing through the options.
    void earlierSettingsFileSavesBackUnchanged()
    {
        QTemporaryDir folder;
        const QString original = QStringLiteral(ZORBIN_SOURCE_DIR "/tests/model/data/saved-settings.ini");
        const QString path = folder.filePath(QStringLiteral("settings.ini"));
        QVERIFY(QFile::copy(original, path));
        QFile::setPermissions(path, QFile::ReadOwner | QFile::WriteOwner);
        {
            auto store = openIniSettingsStore(path);
            CatalogSettings settings;
            fillSourceLists(settings);
            SettingsPersistence persistence(*store, settings);
            load(persistence);
            QVERIFY(persistence.unappliedKeys().isEmpty());
            QCOMPARE(settings.rows, 6);
            QCOMPARE(settings.pageSplit, PageSplit::FilePerPage);
            QCOMPARE(settings.pictureSource, PictureSource::ExtraNote);
            QCOMPARE(settings.lines[5].field, 4);
            persistence.saveAll();
        }
        QCOMPARE(test::readFile(path),
                 test::readFile(original).replace("Weight0=", "WebSections=1\nWeight0="));
    }

    // Each kind of stored text as a load reads it and a save writes it back. A value that
    // cannot be applied is skipped (the rest still load), and a save keeps it in the store as
    // long as the user did not change that option.
    void storedTextForms_data()
    {
        QTest::addColumn<QString>("key");
        QTest::addColumn<QString>("stored");
        QTest::addColumn<bool>("applied");
        QTest::addColumn<QString>("saved");
        auto row = [](const char *name, const char *key, const QString &stored, bool applied,
                      const QString &saved) {
            QTest::newRow(name) << QString::fromLatin1(key) << stored << applied << saved;
        };
        const QString none;
        row("no entry selected", "SortBy", QStringLiteral("-1"), true, QStringLiteral("-1"));
        row("fixed list, last entry", "SortBy", QStringLiteral("2"), true, QStringLiteral("2"));
        row("fixed list, beyond", "SortBy", QStringLiteral("3"), false, QStringLiteral("3"));
        row("fixed list, below none", "SortDir", QStringLiteral("-2"), false, QStringLiteral("-2"));
        row("database list, last entry", "PriceField", QStringLiteral("2"), true, QStringLiteral("2"));
        row("database list, beyond", "PriceField", QStringLiteral("3"), false, QStringLiteral("3"));
        row("database list, not a number", "ExtraNote1", QStringLiteral("x"), false, QStringLiteral("x"));
        row("check box", "Rules", QStringLiteral("1"), true, QStringLiteral("1"));
        row("grey check box counts as not ticked", "Rules", QStringLiteral("2"), true, QStringLiteral("0"));
        row("check box, no such state", "Rules", QStringLiteral("3"), false, QStringLiteral("3"));
        row("check box, below", "UseFilter", QStringLiteral("-1"), false, QStringLiteral("-1"));
        row("option in lower case", "PicSource1", QStringLiteral("true"), true, QStringLiteral("True"));
        row("option as -1", "PicSource1", QStringLiteral("-1"), true, QStringLiteral("True"));
        row("option as 0", "PicSource0", QStringLiteral("0"), true, QStringLiteral("False"));
        row("option as text", "PicSource2", QStringLiteral("maybe"), false, QStringLiteral("maybe"));
        row("format byte", "Size4", QStringLiteral("14"), true, QStringLiteral("14"));
        row("format byte, too large", "Size2", QStringLiteral("300"), false, QStringLiteral("300"));
        row("line tag, last field", "LineTag3", QStringLiteral("8"), true, QStringLiteral("8"));
        row("line tag, no field", "LineTag0", QStringLiteral("9"), false, QStringLiteral("9"));
        row("line tag, empty", "LineTag0", none, true, none);
        row("rows beyond the box's three digits", "Rows", QStringLiteral("1000"), true,
            QStringLiteral("1000"));
        row("rows as a fraction", "Rows", QStringLiteral("12.5"), true, QStringLiteral("12"));
        row("rows not a number", "Rows", QStringLiteral("abc"), true, none);
        row("band below zero", "TopPercent", QStringLiteral("-1"), true, QStringLiteral("-1"));
        row("picture box zero", "ImageH", QStringLiteral("0"), true, QStringLiteral("0"));
        row("web sections off", "WebSections", QStringLiteral("0"), true, QStringLiteral("0"));
    }
    void storedTextForms()
    {
        QFETCH(QString, key);
        QFETCH(QString, stored);
        QFETCH(bool, applied);
        QFETCH(QString, saved);
        MemorySettingsStore store;
        store.set(key, stored);
        CatalogSettings settings;
        fillSourceLists(settings);
        SettingsPersistence persistence(store, settings);
        load(persistence);
        QCOMPARE(persistence.unappliedKeys(), applied ? QStringList() : QStringList{key});
        persistence.saveAll();
        QCOMPARE(store.get(key), saved);
    }

    // The user changes an option whose stored value was refused: the next save writes the
    // change, and leaves the other refused values as they were.
    void aChangedOptionReplacesItsRefusedValue()
    {
        MemorySettingsStore store;
        store.set(QStringLiteral("PriceField"), QStringLiteral("7"));
        store.set(QStringLiteral("Size2"), QStringLiteral("300"));
        store.set(QStringLiteral("LineTag0"), QStringLiteral("9"));
        store.set(QStringLiteral("Italic2"), QStringLiteral("1"));
        CatalogSettings settings;
        fillSourceLists(settings);
        SettingsPersistence persistence(store, settings);
        load(persistence);
        QCOMPARE(settings.lines[2].format.italic, 1);
        settings.priceList1.setCurrentIndex(1);
        settings.lines[2].format.size = 11;
        persistence.saveAll();
        QCOMPARE(store.get(QStringLiteral("PriceField")), QStringLiteral("1"));
        QCOMPARE(store.get(QStringLiteral("Size2")), QStringLiteral("11"));
        QCOMPARE(store.get(QStringLiteral("LineTag0")), QStringLiteral("9"));
        QCOMPARE(persistence.unappliedKeys(), QStringList{QStringLiteral("LineTag0")});
    }

    // The accounting database was unreachable at start-up: its lists are empty, so none of their
    // stored choices can be shown, yet every other option loads and saving loses nothing.
    void unreachableDatabaseLosesNothing()
    {
        MemorySettingsStore store;
        store.set(QStringLiteral("PicExtraNote"), QStringLiteral("1"));
        store.set(QStringLiteral("PagingPath"), QStringLiteral("/srv/catalog"));
        CatalogSettings settings; // no lists filled
        SettingsPersistence persistence(store, settings);
        load(persistence);
        QCOMPARE(settings.outputFolder, QStringLiteral("/srv/catalog"));
        QCOMPARE(settings.pictureNote.currentIndex(), -1);
        persistence.saveAll();
        QCOMPARE(store.get(QStringLiteral("PicExtraNote")), QStringLiteral("1"));
        QVERIFY(!store.has(QStringLiteral("ExtraNote1"))); // its default could not be shown either
    }

    // Rows and columns are the only numbers a catalog cannot be made without.
    void gridOfTheOptions_data()
    {
        QTest::addColumn<QString>("rows");
        QTest::addColumn<QString>("columns");
        QTest::addColumn<QString>("problem"); // a part of the message; empty when the grid is fine
        QTest::newRow("one by one") << QStringLiteral("1") << QStringLiteral("1") << QString();
        QTest::newRow("rows not a number")
            << QStringLiteral("abc") << QStringLiteral("3") << QStringLiteral("\"שורות\"");
        QTest::newRow("no rows") << QStringLiteral("0") << QStringLiteral("3") << QStringLiteral("\"שורות\"");
        QTest::newRow("no columns") << QStringLiteral("8") << QStringLiteral("0")
                                    << QStringLiteral("\"עמודות\"");
        QTest::newRow("columns empty") << QStringLiteral("8") << QString() << QStringLiteral("\"עמודות\"");
        QTest::newRow("just within the bound")
            << QStringLiteral("1000") << QStringLiteral("100") << QString();
        QTest::newRow("beyond the bound")
            << QStringLiteral("1000") << QStringLiteral("101") << QStringLiteral("100,000");
    }
    void gridOfTheOptions()
    {
        QFETCH(QString, rows);
        QFETCH(QString, columns);
        QFETCH(QString, problem);
        MemorySettingsStore store;
        store.set(QStringLiteral("Rows"), rows);
        store.set(QStringLiteral("Cols"), columns);
        CatalogSettings settings;
        SettingsPersistence(store, settings).SetGetRegParams(LoadAction);
        const Result<GridSize> grid = readGridSize(settings);
        QCOMPARE(grid.isOk(), problem.isEmpty());
        if (!grid)
            QVERIFY2(grid.status().description().contains(problem), qPrintable(grid.status().description()));
    }
};

ZORBIN_TEST_CLASS(OptionsTest)
#include "OptionsTest.moc"
