// The options and their store, the grid they make, and the progress bar's width.
#include "model/CatalogSettings.h"
#include "model/GridSize.h"
#include "model/ProgressMeter.h"
#include "model/RunState.h"
#include "model/SettingsPersistence.h"
#include "platform/SettingsStore.h"
#include "testutil/CaseTable.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/TestFiles.h"

#include <QFile>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

// The options loaded from `store` as the start-up loads them, after the lists that the
// accounting database fills were filled (unless it was unreachable).
struct Loaded
{
    explicit Loaded(SettingsStore &store, bool reachable = true) : persistence(store, settings)
    {
        if (reachable) {
            for (ChoiceList *list : {&settings.pictureNote, &settings.extraNote1, &settings.extraNote2}) {
                list->addEntry(u"צבע"_qs, 1);
                list->addEntry(u"תמונה"_qs, 4);
            }
            for (ChoiceList *list : {&settings.priceList1, &settings.priceList2}) {
                list->addEntry(u"מחיר מכירה"_qs, 0);
                list->addEntry(u"סיטונאי"_qs, 3);
                list->addEntry(u"קמעונאי"_qs, 7);
            }
        }
        persistence.SetGetRegParams(LoadAction);
        persistence.GetSetFormLabDefs(LoadAction, StoreApp, StoreSection);
    }

    CatalogSettings settings;
    SettingsPersistence persistence;
};

// Each kind of stored text as a load reads it and a save writes it back (the settings file
// below holds the plain cases). A value that cannot be applied is skipped (the rest still
// load), and a save keeps it in the store as long as the user did not change that option.
const struct
{
    const char *name, *key, *stored;
    bool applied;
    const char *saved;
} StoredTexts[] = {
    {"no entry selected", "SortBy", "-1", true, "-1"},
    {"fixed list, last entry", "SortBy", "2", true, "2"},
    {"fixed list, beyond", "SortBy", "3", false, "3"},
    {"fixed list, below none", "SortDir", "-2", false, "-2"},
    {"database list, beyond", "PriceField", "3", false, "3"},
    {"database list, not a number", "ExtraNote1", "x", false, "x"},
    {"grey check box counts as not ticked", "Rules", "2", true, "0"},
    {"check box, no such state", "Rules", "3", false, "3"},
    {"check box, below", "UseFilter", "-1", false, "-1"},
    {"option in lower case", "PicSource1", "true", true, "True"},
    {"option as -1", "PicSource1", "-1", true, "True"},
    {"option as 0", "PicSource0", "0", true, "False"},
    {"option as text", "PicSource2", "maybe", false, "maybe"},
    {"format byte", "Size4", "14", true, "14"},
    {"format byte, too large", "Size2", "300", false, "300"},
    {"line tag, last field", "LineTag3", "8", true, "8"},
    {"line tag, no field", "LineTag0", "9", false, "9"},
    {"line tag, empty", "LineTag0", "", true, ""},
    {"rows beyond the box's three digits", "Rows", "1000", true, "1000"},
    {"rows as a fraction", "Rows", "12.5", true, "12"},
    {"rows not a number", "Rows", "abc", true, ""},
    {"band below zero", "TopPercent", "-1", true, "-1"},
    {"picture box zero", "ImageH", "0", true, "0"},
};

// Rows and columns are the only numbers a catalog cannot be made without; `problem` is a part of
// the message, empty when the grid is fine.
const struct
{
    const char *name, *rows, *columns, *problem;
} Grids[] = {
    {"one by one", "1", "1", ""},
    {"rows not a number", "abc", "3", "\"שורות\""},
    {"no rows", "0", "3", "\"שורות\""},
    {"no columns", "8", "0", "\"עמודות\""},
    {"columns empty", "8", "", "\"עמודות\""},
    {"just within the bound", "1000", "100", ""},
    {"beyond the bound", "1000", "101", "100,000"},
};

// The progress bar's width: the share of the frame done, rounded half to even.
const struct
{
    const char *name;
    int frame, done, total, width;
} Widths[] = {
    {"5 of 12", 1000, 5, 12, 417},
    {"half down to even", 100, 5, 8, 62},
    {"half up to even", 100, 15, 40, 38},
    {"all", 777, 20, 20, 777},
    {"a total of 0 counts as 1", 100, 1, 0, 100},
};

} // namespace

class ModelTest : public QObject
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
        const QString path = folder.filePath(u"settings.ini"_qs);
        QVERIFY(QFile::copy(original, path));
        QFile::setPermissions(path, QFile::ReadOwner | QFile::WriteOwner);
        {
            auto store = openIniSettingsStore(path);
            Loaded loaded(*store);
            QVERIFY(loaded.persistence.unappliedKeys().isEmpty());
            QCOMPARE(loaded.settings.rows, 6);
            QCOMPARE(loaded.settings.pageSplit, PageSplit::FilePerPage);
            QCOMPARE(loaded.settings.pictureSource, PictureSource::ExtraNote);
            QCOMPARE(loaded.settings.lines[5].field, 4);
            loaded.persistence.saveAll();
        }
        QCOMPARE(readFile(path), readFile(original).replace("Weight0=", "WebSections=1\nWeight0="));
    }

    void storedTextForms_data() { addCaseRows(StoredTexts); }
    void storedTextForms()
    {
        const auto &c = fetchCase(StoredTexts);
        const QString key = QLatin1String(c.key);
        MemorySettingsStore store;
        store.set(key, QLatin1String(c.stored));
        Loaded loaded(store);
        QCOMPARE(loaded.persistence.unappliedKeys(), c.applied ? QStringList() : QStringList{key});
        loaded.persistence.saveAll();
        QCOMPARE(store.get(key), QLatin1String(c.saved));
    }

    // The user changes an option whose stored value was refused: the next save writes the
    // change, and leaves the other refused values as they were.
    void aChangedOptionReplacesItsRefusedValue()
    {
        MemorySettingsStore store;
        store.set(u"PriceField"_qs, u"7"_qs);
        store.set(u"Size2"_qs, u"300"_qs);
        store.set(u"LineTag0"_qs, u"9"_qs);
        store.set(u"Italic2"_qs, u"1"_qs);
        Loaded loaded(store);
        QCOMPARE(loaded.settings.lines[2].format.italic, 1);
        loaded.settings.priceList1.setCurrentIndex(1);
        loaded.settings.lines[2].format.size = 11;
        loaded.persistence.saveAll();
        QCOMPARE(store.get(u"PriceField"_qs), u"1"_qs);
        QCOMPARE(store.get(u"Size2"_qs), u"11"_qs);
        QCOMPARE(store.get(u"LineTag0"_qs), u"9"_qs);
        QCOMPARE(loaded.persistence.unappliedKeys(), QStringList{u"LineTag0"_qs});
    }

    // The accounting database was unreachable at start-up: its lists are empty, so none of their
    // stored choices can be shown, yet every other option loads and saving loses nothing.
    void unreachableDatabaseLosesNothing()
    {
        MemorySettingsStore store;
        store.set(u"PicExtraNote"_qs, u"1"_qs);
        store.set(u"PagingPath"_qs, u"/srv/catalog"_qs);
        Loaded loaded(store, false);
        QCOMPARE(loaded.settings.outputFolder, u"/srv/catalog"_qs);
        QCOMPARE(loaded.settings.pictureNote.currentIndex(), -1);
        loaded.persistence.saveAll();
        QCOMPARE(store.get(u"PicExtraNote"_qs), u"1"_qs);
        QVERIFY(!store.has(u"ExtraNote1"_qs)); // its default could not be shown either
    }

    void gridOfTheOptions_data() { addCaseRows(Grids); }
    void gridOfTheOptions()
    {
        const auto &c = fetchCase(Grids);
        MemorySettingsStore store;
        store.set(u"Rows"_qs, QLatin1String(c.rows));
        store.set(u"Cols"_qs, QLatin1String(c.columns));
        const Result<GridSize> grid = readGridSize(Loaded(store).settings);
        const QString problem = QString::fromUtf8(c.problem);
        QCOMPARE(grid.isOk(), problem.isEmpty());
        if (!grid)
            QVERIFY2(grid.status().description().contains(problem), qPrintable(grid.status().description()));
    }

    void progressWidthIsTheShareOfTheFrame_data() { addCaseRows(Widths); }
    void progressWidthIsTheShareOfTheFrame()
    {
        const auto &c = fetchCase(Widths);
        RecordingUserPort user;
        user.frameWidth = c.frame;
        RunState state;
        ProgressMeter(user, state).point(c.done, c.total);
        QCOMPARE(user.fillWidth, c.width);
        QCOMPARE(user.yields, 1);
    }
};

QTEST_GUILESS_MAIN(ModelTest)
#include "ModelTest.moc"
