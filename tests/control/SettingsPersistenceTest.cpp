#include "model/SettingsPersistence.h"

#include "model/CatalogSettings.h"
#include "platform/Paths.h"
#include "platform/SettingsStore.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/TestMain.h"

#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using zorbin::test::MemorySettingsStore;

namespace {

// What the start-up's list filling leaves when the accounting database answers.
void fillSourceLists(CatalogSettings &settings)
{
    for (ChoiceList *list : {&settings.cmbPicExtraNote, &settings.cmbExtraNote1, &settings.cmbExtraNote2}) {
        list->addEntry(QStringLiteral("צבע"), 1);
        list->addEntry(QStringLiteral("תמונה"), 4);
    }
    for (ChoiceList *list : {&settings.cmbPriceField, &settings.cmbPriceField2}) {
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

class SettingsPersistenceTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void savedStoreHoldsExactlyTheKeys()
    {
        MemorySettingsStore store;
        CatalogSettings settings;
        fillSourceLists(settings);
        SettingsPersistence persistence(store, settings);
        load(persistence);
        persistence.CmdDef_Click();

        const QStringList keys = store.keys();
        QCOMPARE(keys.size(), 115);
        auto count = [&keys](const QString &prefix) {
            return std::count_if(keys.begin(), keys.end(), [&prefix](const QString &key) {
                return key.startsWith(prefix) && key.size() == prefix.size() + 1 && key.back().isDigit();
            });
        };
        QCOMPARE(count(QStringLiteral("CutOff")), 5);
        QCOMPARE(count(QStringLiteral("LineCaption")), 9);
        QCOMPARE(count(QStringLiteral("LineTag")), 9);
        int formatKeys = 0;
        for (const char *prefix : {"Font", "Size", "Weight", "UL", "Italic", "Align"}) {
            QCOMPARE(count(QLatin1String(prefix)), 9);
            formatKeys += int(count(QLatin1String(prefix)));
        }
        QCOMPARE(formatKeys, 54);
        for (int position = 6; position <= 10; ++position)
            QVERIFY(!store.has(QStringLiteral("CutOff%1").arg(position)));
        QVERIFY(store.has(QStringLiteral("LineCaption0")) && store.has(QStringLiteral("Align8")));
    }

    void firstStartShowsEveryDefault()
    {
        MemorySettingsStore store;
        CatalogSettings s;
        fillSourceLists(s);
        SettingsPersistence persistence(store, s);
        load(persistence);

        QVERIFY(persistence.unappliedKeys().isEmpty());
        QCOMPARE(s.ChkCatCode, CheckValue::Unchecked);
        QCOMPARE(s.txtFromSort, QString());
        for (int position = 0; position < CutOffPositions; ++position)
            QCOMPARE(s.ItemCutOff[std::size_t(position)], QStringLiteral("*"));
        QVERIFY(s.OptPicSource.value(0));
        QVERIFY(!s.OptPicSource.value(1) && !s.OptPicSource.value(2));
        for (ChoiceList *list :
             {&s.CmbSortBy, &s.CmbSortDir, &s.cmbPicExtraNote, &s.CmbItemNameType, &s.cmbPriceField,
              &s.cmbPriceField2, &s.cmbExtraNote1, &s.cmbExtraNote2, &s.cmbPicLocation, &s.cmbPageSplit})
            QCOMPARE(list->currentIndex(), 0);
        QCOMPARE(s.txtPicExtension, QStringLiteral(".JPG"));
        QCOMPARE(s.txtPicPath, defaultPictureFolder());
        QCOMPARE(s.txtRows, QStringLiteral("8"));
        QCOMPARE(s.txtCols, QStringLiteral("3"));
        QCOMPARE(s.txtTopTitle, QStringLiteral("קטלוג פריטים"));
        QCOMPARE(s.txtTopTitle2, QStringLiteral("טרניק מערכות מידע"));
        QVERIFY(s.txtBottomTitle.startsWith(QStringLiteral("טלפון: ")));
        QCOMPARE(s.txtPagingPath, defaultOutputFolder());
        QCOMPARE(s.txtTopPercent, QStringLiteral("10"));
        QCOMPARE(s.txtBottomPercent, QStringLiteral("10"));
        QCOMPARE(s.txtImageH, QString());
        for (const CellLine &line : s.lines) {
            QVERIFY(line.caption.isEmpty() && line.tag.isEmpty());
            QCOMPARE(line.format, (CellFormat{0, 9, 0, 0, 0, 0}));
        }
    }

    void storedTextFormsLoad_data()
    {
        QTest::addColumn<QString>("key");
        QTest::addColumn<QString>("stored");
        QTest::addColumn<QString>("shown"); // the property's text after the load
        QTest::newRow("no selection")
            << QStringLiteral("SortBy") << QStringLiteral("-1") << QStringLiteral("-1");
        QTest::newRow("list index") << QStringLiteral("PriceField") << QStringLiteral("2")
                                    << QStringLiteral("2");
        QTest::newRow("check") << QStringLiteral("Rules") << QStringLiteral("1") << QStringLiteral("1");
        QTest::newRow("grey check") << QStringLiteral("Rules") << QStringLiteral("2") << QStringLiteral("2");
        QTest::newRow("option True") << QStringLiteral("PicSource1") << QStringLiteral("True")
                                     << QStringLiteral("True");
        QTest::newRow("option true") << QStringLiteral("PicSource1") << QStringLiteral("true")
                                     << QStringLiteral("True");
        QTest::newRow("option -1") << QStringLiteral("PicSource1") << QStringLiteral("-1")
                                   << QStringLiteral("True");
        QTest::newRow("option 0") << QStringLiteral("PicSource0") << QStringLiteral("0")
                                  << QStringLiteral("False");
        QTest::newRow("option False")
            << QStringLiteral("PicSource0") << QStringLiteral("False") << QStringLiteral("False");
        QTest::newRow("Hebrew text") << QStringLiteral("TopTitle") << QStringLiteral("קטלוג, \"חורף\" 'א'")
                                     << QStringLiteral("קטלוג, \"חורף\" 'א'");
        QTest::newRow("format byte") << QStringLiteral("Size4") << QStringLiteral("14")
                                     << QStringLiteral("14");
    }
    void storedTextFormsLoad()
    {
        QFETCH(QString, key);
        QFETCH(QString, stored);
        QFETCH(QString, shown);
        MemorySettingsStore store;
        store.set(key, stored);
        CatalogSettings settings;
        fillSourceLists(settings);
        SettingsPersistence persistence(store, settings);
        load(persistence);
        QVERIFY(persistence.unappliedKeys().isEmpty());

        MemorySettingsStore saved;
        SettingsPersistence(saved, settings).CmdDef_Click();
        QCOMPARE(saved.get(key), shown);
    }

    void optionButtonsSaveAsWords()
    {
        MemorySettingsStore store;
        CatalogSettings settings;
        fillSourceLists(settings);
        settings.OptPicSource.setValue(2, true);
        SettingsPersistence(store, settings).CmdDef_Click();
        QCOMPARE(store.get(QStringLiteral("PicSource0")), QStringLiteral("False"));
        QCOMPARE(store.get(QStringLiteral("PicSource1")), QStringLiteral("False"));
        QCOMPARE(store.get(QStringLiteral("PicSource2")), QStringLiteral("True"));
    }

    void lineTagShowsItsField()
    {
        MemorySettingsStore store;
        store.set(QStringLiteral("LineTag3"), QStringLiteral("6"));
        store.set(QStringLiteral("LineTag4"), QString());
        store.set(QStringLiteral("LineCaption4"), QStringLiteral("הערה:"));
        CatalogSettings settings;
        fillSourceLists(settings);
        SettingsPersistence persistence(store, settings);
        load(persistence);

        const CellLine &three = settings.lines[3];
        QCOMPARE(three.tag, QStringLiteral("6"));
        QCOMPARE(three.slotCaption(), QStringLiteral("יחידת מידה"));
        QCOMPARE(three.slotColours(), paletteColours());
        const CellLine &four = settings.lines[4];
        QVERIFY(!four.isUsed());
        QCOMPARE(four.slotCaption(), QString());
        QCOMPARE(four.slotColours(), emptySlotColours());
        QCOMPARE(four.caption, QStringLiteral("הערה:"));
    }

    // A stored value that cannot be applied is skipped, the rest still load, and a later save
    // keeps the stored value until the user changes that setting.
    void refusedValueIsKeptInTheStore()
    {
        MemorySettingsStore store;
        store.set(QStringLiteral("PriceField"), QStringLiteral("7")); // the list now has 3 entries
        store.set(QStringLiteral("PriceField2"), QStringLiteral("2"));
        store.set(QStringLiteral("LineTag0"), QStringLiteral("9")); // names no field
        store.set(QStringLiteral("LineCaption1"), QStringLiteral("מחיר:"));
        store.set(QStringLiteral("TopTitle"), QStringLiteral("חורף"));
        store.set(QStringLiteral("Size2"), QStringLiteral("300"));
        store.set(QStringLiteral("Italic2"), QStringLiteral("1"));
        CatalogSettings settings;
        fillSourceLists(settings);
        SettingsPersistence persistence(store, settings);
        load(persistence);

        QCOMPARE(
            persistence.unappliedKeys(),
            (QStringList{QStringLiteral("LineTag0"), QStringLiteral("PriceField"), QStringLiteral("Size2")}));
        QCOMPARE(settings.cmbPriceField.currentIndex(), -1);
        QCOMPARE(settings.lines[0].tag, QString());
        QCOMPARE(settings.cmbPriceField2.currentIndex(), 2);
        QCOMPARE(settings.lines[1].caption, QStringLiteral("מחיר:"));
        QCOMPARE(settings.txtTopTitle, QStringLiteral("חורף"));
        QCOMPARE(settings.lines[2].format.size, 9);
        QCOMPARE(settings.lines[2].format.italic, 1);

        persistence.CmdDef_Click();
        QCOMPARE(store.get(QStringLiteral("PriceField")), QStringLiteral("7"));
        QCOMPARE(store.get(QStringLiteral("LineTag0")), QStringLiteral("9"));
        QCOMPARE(store.get(QStringLiteral("Size2")), QStringLiteral("300"));

        settings.cmbPriceField.setCurrentIndex(1);
        settings.lines[2].format.size = 11;
        persistence.CmdDef_Click();
        QCOMPARE(store.get(QStringLiteral("PriceField")), QStringLiteral("1"));
        QCOMPARE(store.get(QStringLiteral("Size2")), QStringLiteral("11"));
        QCOMPARE(store.get(QStringLiteral("LineTag0")), QStringLiteral("9"));
    }

    // The accounting database was unreachable at start-up: its lists are empty, so none of their
    // stored choices can be shown, yet every other setting loads and saving loses nothing.
    void unreachableDatabaseLosesNothing()
    {
        MemorySettingsStore store;
        store.set(QStringLiteral("PicExtraNote"), QStringLiteral("1"));
        store.set(QStringLiteral("PriceField"), QStringLiteral("2"));
        store.set(QStringLiteral("PagingPath"), QStringLiteral("/srv/catalog"));
        CatalogSettings settings; // no lists filled
        SettingsPersistence persistence(store, settings);
        load(persistence);

        QCOMPARE(settings.txtPagingPath, QStringLiteral("/srv/catalog"));
        QCOMPARE(settings.txtTopTitle, QStringLiteral("קטלוג פריטים"));
        QCOMPARE(settings.cmbPageSplit.currentIndex(), 0);
        QCOMPARE(settings.cmbPicExtraNote.currentIndex(), -1);
        persistence.CmdDef_Click();
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
        QCOMPARE(settings.txtTopTitle, QString());
    }

    // The same record survives a save and a load through the INI store the command line reads.
    void roundTripThroughAnIniFile()
    {
        QTemporaryDir folder;
        QVERIFY(folder.isValid());
        const QString path = folder.filePath(QStringLiteral("settings.ini"));
        {
            auto store = openIniSettingsStore(path);
            CatalogSettings settings;
            fillSourceLists(settings);
            settings.txtTopTitle = QStringLiteral("קטלוג, \"חורף\"");
            settings.txtLogo = QStringLiteral("/home/shop/לוגו; 1.png");
            settings.ItemCutOff[2] = QStringLiteral("A");
            settings.lines[5].tag = QStringLiteral("4");
            settings.lines[5].caption = QStringLiteral("מחיר 1:");
            settings.lines[5].format = CellFormat{2, 14, 1, 1, 0, 2};
            settings.cmbPriceField2.setCurrentIndex(2);
            settings.ChkCatCode = CheckValue::Checked;
            SettingsPersistence(*store, settings).CmdDef_Click();
        }
        auto store = openIniSettingsStore(path);
        CatalogSettings settings;
        fillSourceLists(settings);
        SettingsPersistence persistence(*store, settings);
        load(persistence);
        QVERIFY(persistence.unappliedKeys().isEmpty());
        QCOMPARE(settings.txtTopTitle, QStringLiteral("קטלוג, \"חורף\""));
        QCOMPARE(settings.txtLogo, QStringLiteral("/home/shop/לוגו; 1.png"));
        QCOMPARE(settings.ItemCutOff[2], QStringLiteral("A"));
        QCOMPARE(settings.lines[5].tag, QStringLiteral("4"));
        QCOMPARE(settings.lines[5].caption, QStringLiteral("מחיר 1:"));
        QCOMPARE(settings.lines[5].format, (CellFormat{2, 14, 1, 1, 0, 2}));
        QCOMPARE(settings.cmbPriceField2.currentIndex(), 2);
        QCOMPARE(settings.ChkCatCode, CheckValue::Checked);
    }
};

ZORBIN_TEST_CLASS(SettingsPersistenceTest)
#include "SettingsPersistenceTest.moc"
