#include "source/ConnectionString.h"
#include "source/SourceConnection.h"
#include "testutil/AccountingFixture.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QCryptographicHash>
#include <QDir>
#include <QFileInfo>
#include <QSqlRecord>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

QString jetFile(const QString &name)
{
    return QDir(testDataFolder()).filePath(QStringLiteral("jet/") + name);
}

std::unique_ptr<SourceConnection> openFile(const QString &path)
{
    auto opened = SourceConnection::open(BuildConnString(fileConnection(path)));
    if (!opened) {
        QTest::qFail(qPrintable(opened.status().description()), __FILE__, __LINE__);
        return nullptr;
    }
    return std::move(opened).value();
}

// Every row of a statement, each as its values.
QList<QVariantList> rowsOf(SourceConnection &source, const QString &sql)
{
    auto query = source.select(sql);
    if (!query) {
        QTest::qFail(qPrintable(query.status().description()), __FILE__, __LINE__);
        return {};
    }
    QList<QVariantList> rows;
    while (query->next()) {
        QVariantList row;
        for (int i = 0; i < query->record().count(); ++i)
            row << query->value(i);
        rows << row;
    }
    return rows;
}

QByteArray fingerprint(const QString &path)
{
    return QCryptographicHash::hash(readFile(path), QCryptographicHash::Sha256) +
           QFileInfo(path).lastModified().toString(Qt::ISODateWithMs).toUtf8();
}

} // namespace

class FileSourceTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void recognisesTheKindOfFileByItsContent()
    {
        QTemporaryDir folder;
        // A Jet file under another name is still a Jet file.
        const QString renamed = folder.filePath(QStringLiteral("company.db"));
        QVERIFY(QFile::copy(jetFile(QStringLiteral("nwind.mdb")), renamed));
        auto source = openFile(renamed);
        QVERIFY(source);
        QCOMPARE(rowsOf(*source, QStringLiteral("SELECT * FROM Shippers")).size(), 3);
    }

    void readsAJetFile()
    {
        auto source = openFile(jetFile(QStringLiteral("nwind.mdb")));
        QVERIFY(source);
        auto products =
            source->select(QStringLiteral("SELECT ProductID, ProductName, UnitPrice, Discontinued "
                                          "FROM Products ORDER BY ProductID"));
        QVERIFY2(products, qPrintable(products.status().description()));
        QVERIFY(products->next());
        QCOMPARE(products->value(QStringLiteral("ProductID")).toInt(), 1);
        QCOMPARE(products->value(QStringLiteral("ProductName")).metaType().id(), QMetaType::QString);
        QCOMPARE(products->value(QStringLiteral("ProductName")).toString(), QStringLiteral("Chai"));
        QCOMPARE(products->value(QStringLiteral("UnitPrice")).toDouble(), 18.0);
        QCOMPARE(products->value(QStringLiteral("Discontinued")).toInt(), 0);
        int count = 1;
        int discontinued = 0;
        while (products->next()) {
            ++count;
            discontinued += products->value(3).toInt();
        }
        QCOMPARE(count, 77);
        QCOMPARE(discontinued, 8);
    }

    void keepsNullsOfAJetFile()
    {
        auto source = openFile(jetFile(QStringLiteral("nwind.mdb")));
        QVERIFY(source);
        const auto rows =
            rowsOf(*source, QStringLiteral("SELECT EmployeeID, ReportsTo, Region, LastName FROM Employees "
                                           "ORDER BY EmployeeID"));
        QCOMPARE(rows.size(), 9);
        QCOMPARE(rows.at(0).at(1).toInt(), 2); // Davolio reports to Fuller
        QVERIFY(rows.at(1).at(1).isNull());    // Fuller reports to nobody
        QCOMPARE(rows.at(0).at(2).toString(), QStringLiteral("WA"));
        QVERIFY(rows.at(4).at(2).isNull()); // Buchanan, London: no region
        QVERIFY(!rows.at(4).at(3).isNull());
    }

    // mdbtools answers only single-table queries; the statements of the catalog join tables.
    void joinsTablesOfAJetFile()
    {
        auto source = openFile(jetFile(QStringLiteral("nwind.mdb")));
        QVERIFY(source);
        const auto rows =
            rowsOf(*source, QStringLiteral("SELECT Products.ProductName, Categories.CategoryName FROM "
                                           "Products, Categories WHERE Products.CategoryID = "
                                           "Categories.CategoryID And Products.ProductID = 1"));
        QCOMPARE(rows.size(), 1);
        QCOMPARE(rows.at(0).at(1).toString(), QStringLiteral("Beverages"));
        QCOMPARE(rowsOf(*source, QStringLiteral("SELECT * FROM [Order Details]")).size(), 2155);
        // Texts compare without regard to letter case, as in the file's own engine.
        QCOMPARE(rowsOf(*source, QStringLiteral("SELECT * FROM Products WHERE ProductName = 'CHAI'")).size(),
                 1);
    }

    void readsAnAccessFile()
    {
        auto source = openFile(jetFile(QStringLiteral("ASampleDatabase.accdb")));
        QVERIFY(source);
        const auto rows =
            rowsOf(*source, QStringLiteral("SELECT [Asset No], Cost, Warranty, Comments, Acquired "
                                           "FROM [Asset Items] ORDER BY [Asset No]"));
        QCOMPARE(rows.size(), 65);
        const QVariantList &last = rows.constLast();
        QCOMPARE(last.at(0).toString(), QStringLiteral("30118"));
        QCOMPARE(last.at(1).metaType().id(), QMetaType::Double);
        QCOMPARE(last.at(1).toDouble(), 3425.5);
        QCOMPARE(last.at(2).toInt(), 0);
        QVERIFY(last.at(3).isNull());
        QVERIFY(last.at(4).toString().startsWith(QLatin1String("1999-10-27")));
    }

    void namesATableTheFileDoesNotHave()
    {
        auto source = openFile(jetFile(QStringLiteral("nwind.mdb")));
        QVERIFY(source);
        const auto rows = source->select(QStringLiteral("SELECT * FROM Accounts"));
        QVERIFY(!rows);
        QVERIFY2(rows.status().description().contains(QStringLiteral("\"Accounts\"")),
                 qPrintable(rows.status().description()));
        QVERIFY(rows.status().description().contains(QStringLiteral("nwind.mdb")));
    }

    void readsTheDemoDatabase()
    {
        QTemporaryDir folder;
        auto source = openFile(copyDemoDatabase(folder.path()));
        QVERIFY(source);
        const auto rows =
            rowsOf(*source, QStringLiteral("SELECT ItemKey, ItemName, SortGroup, Price, ExFile FROM Items "
                                           "WHERE ItemKey = 'C0002'"));
        QCOMPARE(rows.size(), 1);
        QCOMPARE(rows.at(0).at(1).toString(), QStringLiteral("מנורה עץ אלון 12"));
        QCOMPARE(rows.at(0).at(2).toInt(), 3);
        QCOMPARE(rows.at(0).at(3).toDouble(), 84.4);
        QVERIFY(QFileInfo::exists(rows.at(0).at(4).toString()));
        QVERIFY(rowsOf(*source, QStringLiteral("SELECT Price FROM Items WHERE ItemKey = 'B0041'"))
                    .at(0)
                    .at(0)
                    .isNull());
        QVERIFY(rowsOf(*source, QStringLiteral("SELECT ItemName FROM Items WHERE ItemKey = 'F0053'"))
                    .at(0)
                    .at(0)
                    .isNull());
    }

    // Nothing is ever written to the accounting database: only single SELECT statements are
    // sent, and a file is opened read-only.
    void neverWritesTheFile_data()
    {
        QTest::addColumn<QString>("file");
        QTest::addColumn<QString>("table");
        QTest::newRow("Jet") << jetFile(QStringLiteral("nwind.mdb")) << "Shippers";
        QTest::newRow("Access") << jetFile(QStringLiteral("ASampleDatabase.accdb")) << "[Asset Items]";
        QTest::newRow("SQLite") << demoDatabasePath() << "Accounts";
    }
    void neverWritesTheFile()
    {
        QFETCH(QString, file);
        QFETCH(QString, table);
        QTemporaryDir folder;
        const QString copy = folder.filePath(QFileInfo(file).fileName());
        QVERIFY(QFile::copy(file, copy));
        QVERIFY(QFile::setPermissions(copy, QFileDevice::ReadOwner | QFileDevice::WriteOwner));
        const QByteArray before = fingerprint(copy);
        {
            auto source = openFile(copy);
            QVERIFY(source);
            QVERIFY(!rowsOf(*source, QStringLiteral("SELECT * FROM ") + table).isEmpty());
            for (const QString &statement :
                 {QStringLiteral("DELETE FROM ") + table, QStringLiteral("SELECT 1; DELETE FROM ") + table,
                  QStringLiteral("  update ") + table + QStringLiteral(" SET x = 1"),
                  // A quote mark in a comment must not hide the ";" that follows it.
                  QStringLiteral("SELECT 1 -- it's\n; DELETE FROM ") + table,
                  QStringLiteral("SELECT 1 -- it's\r; DELETE FROM ") + table,
                  QStringLiteral("SELECT 1 /* it's */; DELETE FROM ") + table}) {
                const auto refused = source->select(statement);
                QVERIFY(!refused);
                QVERIFY(refused.status().description().contains(QStringLiteral("SELECT")));
            }
            // A ";" or a comment mark inside a quoted text is part of the text.
            QVERIFY(source->select(QStringLiteral("SELECT * FROM ") + table +
                                   QStringLiteral(" WHERE 'a;b--/*' = 'c'")));
            // A line comment quotes nothing, nor does a quote mark inside it.
            QVERIFY(source->select(QStringLiteral("SELECT * FROM ") + table + QStringLiteral(" -- it's;")));
            // Even past the guard the database file does not take a change.
            QSqlQuery direct(source->database());
            if (!file.endsWith(QLatin1String(".db")))
                QVERIFY(direct.exec(QStringLiteral("DELETE FROM ") + table)); // only the in-memory copy
            else
                QVERIFY(!direct.exec(QStringLiteral("DELETE FROM ") + table));
        }
        QCOMPARE(fingerprint(copy), before);
    }

    void explainsAFileItCannotRead_data()
    {
        QTest::addColumn<QByteArray>("content"); // empty: no file at all
        QTest::addColumn<QString>("expected");
        QTest::newRow("missing") << QByteArray() << "לא נמצא";
        QTest::newRow("text file") << QByteArray("ItemKey;ItemName\nA1;chair\n") << "SQLite";
        QTest::newRow("short file") << QByteArray("ab") << ".accdb";
    }
    void explainsAFileItCannotRead()
    {
        QFETCH(QByteArray, content);
        QFETCH(QString, expected);
        QTemporaryDir folder;
        const QString path = folder.filePath(QStringLiteral("company.mdb"));
        if (!content.isEmpty())
            writeFile(path, content);
        const auto opened = SourceConnection::open(BuildConnString(fileConnection(path)));
        QVERIFY(!opened);
        QVERIFY2(opened.status().description().contains(path), qPrintable(opened.status().description()));
        QVERIFY(opened.status().description().contains(expected));
    }

    void noConnectionTypeNeverConnects()
    {
        const auto opened = SourceConnection::open(BuildConnString(
            QStringLiteral("s"), QStringLiteral("u"), QString(), QStringLiteral("d"), ConnectionKind::None));
        QVERIFY(!opened);
        QVERIFY(opened.status().description().contains(QStringLiteral("סוג בסיס הנתונים")));
    }

    // When the driver that the connection names is not installed, the fault says how to register it.
    void tellsHowToRegisterAMissingDriver()
    {
        const auto opened = SourceConnection::open(
            QStringLiteral("driver={Zorbin No Such Driver};server=127.0.0.1;uid=sa;pwd=;database=x"));
        QVERIFY(!opened);
        const QString text = opened.status().description();
        QVERIFY2(text.contains(QStringLiteral("Zorbin No Such Driver")), qPrintable(text));
        QVERIFY(text.contains(QStringLiteral("odbcinst.ini")));
        QVERIFY(text.contains(QStringLiteral("[unixODBC]"))); // the driver manager's own words first

        // A registered driver that fails says only what the driver says.
        const auto failed =
            SourceConnection::open(QStringLiteral("driver={SQLite3};database=/nonexistent/folder/x.db"));
        QVERIFY(!failed);
        QVERIFY2(!failed.status().description().contains(QStringLiteral("odbcinst.ini")),
                 qPrintable(failed.status().description()));
    }
};

ZORBIN_TEST_CLASS(FileSourceTest)
#include "FileSourceTest.moc"
