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

    // Each kind of stored text as a load reads it and a save writes it back.
    void storedTextForms_data()
    {
        QTest::addColumn<QString>("key");
        QTest::addColumn<QString>("stored");
        QTest::addColumn<QString>("saved");
        auto row = [](const char *name, const char *key, const QString &stored, const QString &saved) {
            QTest::newRow(name) << QString::fromLatin1(key) << stored << saved;
        };
        row("no entry selected", "SortBy", QStringLiteral("-1"), QStringLiteral("-1"));
        row("list filled from the database", "PriceField", QStringLiteral("2"), QStringLiteral("2"));
        row("grey check box counts as not ticked", "Rules", QStringLiteral("2"), QStringLiteral("0"));
        row("option in lower case", "PicSource1", QStringLiteral("true"), QStringLiteral("True"));
        row("option as -1", "PicSource1", QStringLiteral("-1"), QStringLiteral("True"));
        row("option as 0", "PicSource0", QStringLiteral("0"), QStringLiteral("False"));
        row("Hebrew text with quotes", "TopTitle", QStringLiteral("קטלוג, \"חורף\" 'א'"),
            QStringLiteral("קטלוג, \"חורף\" 'א'"));
        row("format byte", "Size4", QStringLiteral("14"), QStringLiteral("14"));
        row("line tag", "LineTag3", QStringLiteral("6"), QStringLiteral("6"));
        row("rows beyond the box's three digits", "Rows", QStringLiteral("1000"), QStringLiteral("1000"));
        row("rows as a fraction", "Rows", QStringLiteral("12.5"), QStringLiteral("12"));
        row("rows not a number", "Rows", QStringLiteral("abc"), QString());
        row("band not a number", "TopPercent", QStringLiteral("abc"), QString());
        row("band below zero", "TopPercent", QStringLiteral("-1"), QStringLiteral("-1"));
        row("picture box empty", "ImageH", QString(), QString());
        row("picture box zero", "ImageH", QStringLiteral("0"), QStringLiteral("0"));
        row("web sections off", "WebSections", QStringLiteral("0"), QStringLiteral("0"));
    }
    void storedTextForms()
    {
        QFETCH(QString, key);
        QFETCH(QString, stored);
        QFETCH(QString, saved);
        MemorySettingsStore store;
        store.set(key, stored);
        CatalogSettings settings;
        fillSourceLists(settings);
        SettingsPersistence persistence(store, settings);
        load(persistence);
        QVERIFY(persistence.unappliedKeys().isEmpty());
        MemorySettingsStore written;
        SettingsPersistence(written, settings).saveAll();
        QCOMPARE(written.get(key), saved);
    }

    // A stored value that cannot be applied is skipped, the rest still load, and a later save
    // keeps the stored value until the user changes that option.
    void refusedValueIsKeptInTheStore()
    {
        MemorySettingsStore store;
        store.set(QStringLiteral("PriceField"), QStringLiteral("7")); // the list now has 3 entries
        store.set(QStringLiteral("PriceField2"), QStringLiteral("2"));
        store.set(QStringLiteral("LineTag0"), QStringLiteral("9")); // names no field
        store.set(QStringLiteral("SortBy"), QStringLiteral("3"));
        store.set(QStringLiteral("Size2"), QStringLiteral("300"));
        store.set(QStringLiteral("Italic2"), QStringLiteral("1"));
        CatalogSettings settings;
        fillSourceLists(settings);
        SettingsPersistence persistence(store, settings);
        load(persistence);

        QCOMPARE(persistence.unappliedKeys(),
                 (QStringList{QStringLiteral("LineTag0"), QStringLiteral("PriceField"),
                              QStringLiteral("Size2"), QStringLiteral("SortBy")}));
        QCOMPARE(settings.priceList1.currentIndex(), -1);
        QCOMPARE(settings.priceList2.currentIndex(), 2);
        QCOMPARE(settings.lines[2].format.italic, 1);

        persistence.saveAll();
        QCOMPARE(store.get(QStringLiteral("PriceField")), QStringLiteral("7"));
        QCOMPARE(store.get(QStringLiteral("LineTag0")), QStringLiteral("9"));
        QCOMPARE(store.get(QStringLiteral("SortBy")), QStringLiteral("3"));

        settings.priceList1.setCurrentIndex(1);
        settings.lines[2].format.size = 11;
        persistence.saveAll();
        QCOMPARE(store.get(QStringLiteral("PriceField")), QStringLiteral("1"));
        QCOMPARE(store.get(QStringLiteral("Size2")), QStringLiteral("11"));
        QCOMPARE(store.get(QStringLiteral("LineTag0")), QStringLiteral("9"));
    }

    // The accounting database was unreachable at start-up: its lists are empty, so none of their
    // stored choices can be shown, yet every other option loads and saving loses nothing.
    void unreachableDatabaseLosesNothing()
    {
        MemorySettingsStore store;
        store.set(QStringLiteral("PicExtraNote"), QStringLiteral("1"));
        store.set(QStringLiteral("PriceField"), QStringLiteral("2"));
        store.set(QStringLiteral("PagingPath"), QStringLiteral("/srv/catalog"));
        CatalogSettings settings; // no lists filled
        SettingsPersistence persistence(store, settings);
        load(persistence);

        QCOMPARE(settings.outputFolder, QStringLiteral("/srv/catalog"));
        QCOMPARE(settings.pictureNote.currentIndex(), -1);
        persistence.saveAll();
        QCOMPARE(store.get(QStringLiteral("PicExtraNote")), QStringLiteral("1"));
        QCOMPARE(store.get(QStringLiteral("PriceField")), QStringLiteral("2"));
        QVERIFY(!store.has(QStringLiteral("ExtraNote1"))); // its default could not be shown either
    }

    void otherActionsDoNothing()
    {
        MemorySettingsStore store;
        store.set(QStringLiteral("TopTitle"), QStringLiteral("חורף"));
        CatalogSettings settings;
        SettingsPersistence persistence(store, settings);
        persistence.SetGetRegParams(0);
        persistence.SetGetRegParams(3);
        persistence.GetSetFormLabDefs(7, StoreApp, StoreSection);
        QCOMPARE(store.writes, 0);
        QCOMPARE(settings.topTitle, QStringLiteral("קטלוג פריטים"));
    }

    // Rows and columns are the only numbers a catalog cannot be made without.
    void gridOfTheOptions_data()
    {
        QTest::addColumn<QString>("rows");
        QTest::addColumn<QString>("columns");
        QTest::addColumn<QString>("problem"); // a part of the message; empty when the grid is fine
        QTest::newRow("one by one") << QStringLiteral("1") << QStringLiteral("1") << QString();
        QTest::newRow("1000 rows") << QStringLiteral("1000") << QStringLiteral("3") << QString();
        QTest::newRow("rows not a number")
            << QStringLiteral("abc") << QStringLiteral("3") << QStringLiteral("\"שורות\"");
        QTest::newRow("rows empty") << QString() << QStringLiteral("3") << QStringLiteral("\"שורות\"");
        QTest::newRow("no columns") << QStringLiteral("8") << QStringLiteral("0")
                                    << QStringLiteral("\"עמודות\"");
        QTest::newRow("columns below zero")
            << QStringLiteral("8") << QStringLiteral("-2") << QStringLiteral("\"עמודות\"");
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
