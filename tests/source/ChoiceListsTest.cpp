#include "source/ChoiceLists.h"

#include "DemoExpectations.h"
#include "control/Program.h"
#include "platform/FileSystem.h"
#include "platform/SettingsStore.h"
#include "testutil/AccountingFixture.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/TestMain.h"

#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

const Entries DemoNotes = demoNoteEntries();
const Entries DemoPriceLists = demoPriceListEntries();

// Puts one entry into each of the five lists and selects it, to see whether a filling touched them.
void markLists(CatalogSettings &settings)
{
    for (ChoiceList *list : settings.sourceLists()) {
        list->clear();
        list->addEntry(QStringLiteral("earlier"), 99);
        list->setCurrentIndex(0);
    }
}

bool listsAreMarked(CatalogSettings &settings)
{
    for (ChoiceList *list : settings.sourceLists()) {
        if (entriesOf(*list) != Entries{{QStringLiteral("earlier"), 99}} || list->currentIndex() != 0)
            return false;
    }
    return true;
}

} // namespace

class ChoiceListsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void fillsTheListsFromTheDemoDatabase()
    {
        QTemporaryDir folder;
        const ConnectionParams demo = fileConnection(copyDemoDatabase(folder.path()));
        CatalogSettings settings;
        markLists(settings);
        FillCmbExtraNote(demo, settings);
        FillCmbPriceField(demo, settings);
        // Ascending NoteID; kinds of other owners, blank, empty and Null names left out; names trimmed.
        QCOMPARE(entriesOf(settings.pictureNote), DemoNotes);
        QCOMPARE(entriesOf(settings.extraNote1), DemoNotes);
        QCOMPARE(entriesOf(settings.extraNote2), DemoNotes);
        // The sales price first, then the price lists in the order the table returns them.
        QCOMPARE(entriesOf(settings.priceList1), DemoPriceLists);
        QCOMPARE(entriesOf(settings.priceList2), DemoPriceLists);
        // Clearing a list drops its selection.
        QCOMPARE(settings.priceList1.currentIndex(), -1);
    }

    void followsTheRowsOfTheNamesTables_data()
    {
        const QString salesPrice = QStringLiteral("מחיר מכירה");
        const Entries kept = {{QStringLiteral("earlier"), 99}};
        QTest::addColumn<QStringList>("rows");
        QTest::addColumn<Entries>("notes");
        QTest::addColumn<Entries>("priceLists");
        QTest::newRow("empty tables") << QStringList() << kept << kept;
        QTest::newRow("one price list X, number 7")
            << QStringList{QStringLiteral(
                   "INSERT INTO PriceListNames (PriceListID, PriceListName) VALUES (7, 'X')")}
            << kept << Entries{{salesPrice, 0}, {QStringLiteral("X"), 7}};
        QTest::newRow("only blank names")
            << QStringList{QStringLiteral(
                               "INSERT INTO PriceListNames (PriceListID, PriceListName) VALUES (1, ' '), (2, NULL)"),
                           QStringLiteral("INSERT INTO ExtraNoteNames VALUES (1, '', 1), (2, NULL, 1)")}
            << Entries{} << Entries{{salesPrice, 0}};
        QTest::newRow("only note kinds of other owners")
            << QStringList{QStringLiteral("INSERT INTO ExtraNoteNames VALUES (1, 'a', 0), (2, 'b', 2)")}
            << kept << kept;
        QTest::newRow("numbers given as texts and fractions")
            << QStringList{QStringLiteral(
                   "INSERT INTO ExtraNoteNames VALUES ('12', 'twelve', 1), (2.5, 'two and a half', 1)")}
            << Entries{{QStringLiteral("two and a half"), 2}, {QStringLiteral("twelve"), 12}} << kept;
    }
    void followsTheRowsOfTheNamesTables()
    {
        QFETCH(QStringList, rows);
        QFETCH(Entries, notes);
        QFETCH(Entries, priceLists);
        QTemporaryDir folder;
        const QString path = folder.filePath(QStringLiteral("accounting.db"));
        QVERIFY(makeAccountingFile(path, rows));
        CatalogSettings settings;
        markLists(settings);
        FillCmbExtraNote(fileConnection(path), settings);
        FillCmbPriceField(fileConnection(path), settings);
        QCOMPARE(entriesOf(settings.pictureNote), notes);
        QCOMPARE(entriesOf(settings.extraNote1), notes);
        QCOMPARE(entriesOf(settings.extraNote2), notes);
        QCOMPARE(entriesOf(settings.priceList1), priceLists);
        QCOMPARE(entriesOf(settings.priceList2), priceLists);
    }

    // A failure ends the filling at once and silently; what was added so far stays.
    void stopsAtTheFirstFailure()
    {
        QTemporaryDir folder;
        const QString path = folder.filePath(QStringLiteral("accounting.db"));
        // A number that does not convert: SQLite orders texts after numbers.
        QVERIFY(makeAccountingFile(
            path,
            {QStringLiteral("INSERT INTO ExtraNoteNames VALUES (1, 'a', 1), ('x', 'b', 1), (3, 'c', 1)")}));
        CatalogSettings settings;
        markLists(settings);
        FillCmbExtraNote(fileConnection(path), settings);
        QCOMPARE(entriesOf(settings.pictureNote),
                 (Entries{{QStringLiteral("a"), 1}, {QStringLiteral("c"), 3}}));
        QCOMPARE(entriesOf(settings.extraNote2),
                 (Entries{{QStringLiteral("a"), 1}, {QStringLiteral("c"), 3}}));

        // A names table without the name column: the rows are there, the names are not.
        QVERIFY(makeAccountingFile(
            path, {QStringLiteral("DROP TABLE PriceListNames"),
                   QStringLiteral("CREATE TABLE PriceListNames (PriceListID INTEGER, Name TEXT)"),
                   QStringLiteral("INSERT INTO PriceListNames VALUES (1, 'a')")}));
        markLists(settings);
        FillCmbPriceField(fileConnection(path), settings);
        QCOMPARE(entriesOf(settings.priceList1), (Entries{{QStringLiteral("מחיר מכירה"), 0}}));
    }

    void nothingChangesWhenTheDatabaseCannotBeReached()
    {
        QTemporaryDir folder;
        ConnectionParams unreachable = fileConnection(folder.filePath(QStringLiteral("missing.db")));
        CatalogSettings settings;
        markLists(settings);
        FillCmbExtraNote(unreachable, settings);
        FillCmbPriceField(unreachable, settings);
        unreachable.kind = ConnectionKind::None;
        FillCmbExtraNote(unreachable, settings);
        FillCmbPriceField(unreachable, settings);
        QVERIFY(listsAreMarked(settings));
    }

    void trimOrEmpty_data()
    {
        QTest::addColumn<QVariant>("value");
        QTest::addColumn<QString>("text");
        QTest::newRow("Null") << QVariant() << "";
        QTest::newRow("null text") << QVariant(QMetaType::fromType<QString>()) << "";
        QTest::newRow("empty") << QVariant(QString()) << "";
        QTest::newRow("blanks") << QVariant(QStringLiteral("   ")) << "";
        QTest::newRow("surrounded") << QVariant(QStringLiteral("  מחירון א  ")) << "מחירון א";
        QTest::newRow("number") << QVariant(7) << "7";
    }
    void trimOrEmpty()
    {
        QFETCH(QVariant, value);
        QFETCH(QString, text);
        QCOMPARE(TrimOrEmpty(value), text);
    }

    // The control starts on the demo settings: the lists are filled from the demo database
    // before the stored list indexes are applied, and nothing is said.
    void startUpFillsTheListsBeforeTheSettings()
    {
        QTemporaryDir folder;
        auto store = copyDemoSettings(folder.path());
        RecordingUserPort user;
        const auto assembled = assembleControl(user, *store);
        CatalogControl &control = *assembled;
        control.startUp();
        CatalogSettings &settings = control.settings();
        QCOMPARE(control.connection().kind, ConnectionKind::File);
        QCOMPARE(entriesOf(settings.priceList1), DemoPriceLists);
        QCOMPARE(entriesOf(settings.extraNote2), DemoNotes);
        QCOMPARE(settings.priceList1.currentIndex(), 1);
        QCOMPARE(settings.priceList1.currentItemData(), std::optional<std::int32_t>(1));
        QCOMPARE(settings.extraNote1.currentIndex(), 1);
        QCOMPARE(settings.extraNote1.currentItemData(), std::optional<std::int32_t>(2));
        QCOMPARE(settings.pictureNote.currentItemData(), std::optional<std::int32_t>(3));
        QVERIFY(control.persistence().unappliedKeys().isEmpty());
        QVERIFY(user.messages.isEmpty());
        QVERIFY(user.questions.isEmpty());

        // The rest of the demo's settings read back as the script wrote them: a picture, the
        // name, the key and a price in each cell, a file per page, pictures of at most 120 x 120.
        QCOMPARE(settings.lines[0].field, 0);
        QCOMPARE(settings.lines[1].field, 2);
        QCOMPARE(settings.lines[2].field, 1);
        QCOMPARE(settings.lines[2].caption, QStringLiteral("פריט: "));
        QCOMPARE(settings.lines[3].field, 4);
        QVERIFY(!settings.lines[4].isUsed());
        QCOMPARE(settings.lines[1].format.weight, std::uint8_t(1));
        QVERIFY(settings.collectPrice1);
        QCOMPARE(settings.pageSplit, PageSplit::FilePerPage);
        QCOMPARE(settings.pictureSource, PictureSource::FileField);
        QCOMPARE(settings.pictureHeight, 120);
        QCOMPARE(settings.pictureWidth, 120);
        QCOMPARE(settings.topTitle2, QStringLiteral("בית וגן בע\"מ"));
        QVERIFY(QFileInfo(settings.logo).isFile());
    }

    void startUpWithoutTheDatabaseSaysNothing()
    {
        QTemporaryDir folder;
        auto store = copyDemoSettings(folder.path());
        store->write(QStringLiteral("Zorbin"), QStringLiteral("Params"), QStringLiteral("ConnServer"),
                     folder.path());
        RecordingUserPort user;
        const auto control = assembleControl(user, *store);
        control->startUp();
        for (ChoiceList *list : control->settings().sourceLists())
            QCOMPARE(list->count(), 0);
        QVERIFY(control->persistence().unappliedKeys().contains(QStringLiteral("PriceField")));
        QVERIFY(user.messages.isEmpty());
    }
};

ZORBIN_TEST_CLASS(ChoiceListsTest)
#include "ChoiceListsTest.moc"
