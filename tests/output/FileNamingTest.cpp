// Page and picture names, and the conversions of stored values into page text.
#include "output/FileNaming.h"

#include "platform/Paths.h"
#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;

class FileNamingTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void pageNames_data()
    {
        QTest::addColumn<qint64>("page");
        QTest::addColumn<QString>("expected");
        QTest::newRow("first") << qint64(1) << QStringLiteral("/out/zoindex.htm");
        QTest::newRow("second") << qint64(2) << QStringLiteral("/out/zo000002.htm");
        QTest::newRow("twelfth") << qint64(12) << QStringLiteral("/out/zo000012.htm");
        QTest::newRow("16-bit limit") << qint64(32767) << QStringLiteral("/out/zo032767.htm");
        QTest::newRow("beyond 16 bits") << qint64(32768) << QStringLiteral("/out/zo032768.htm");
        QTest::newRow("seven digits") << qint64(1234567) << QStringLiteral("/out/zo1234567.htm");
    }

    void pageNames()
    {
        QFETCH(qint64, page);
        QFETCH(QString, expected);
        QCOMPARE(HTMLFileName(QStringLiteral("/out/zo"), page), expected);
    }

    void pictureNames_data()
    {
        const QString s = pathSeparator();
        QTest::addColumn<QString>("reference");
        QTest::addColumn<QString>("expected");
        const QString images = s + QStringLiteral("cat") + s + QStringLiteral("images");
        QTest::newRow("full path") << s + QStringLiteral("photos") + s + QStringLiteral("A12.JPG")
                                   << images + s + QStringLiteral("A12.JPG");
        QTest::newRow("bare name") << QStringLiteral("A12.JPG") << images + s + QStringLiteral("A12.JPG");
        QTest::newRow("ends in a separator") << QStringLiteral("photos") + s << images + s;
        QTest::newRow("empty") << QString() << QString();
        QTest::newRow("colon does not separate")
            << QStringLiteral("x:A12.JPG") << images + s + QStringLiteral("x:A12.JPG");
        const QString other =
            pathSeparator() == QLatin1Char('/') ? QStringLiteral("\\") : QStringLiteral("/");
        QTest::newRow("the other separator does not separate")
            << QStringLiteral("a") + other + QStringLiteral("b.png")
            << images + s + QStringLiteral("a") + other + QStringLiteral("b.png");
    }

    void pictureNames()
    {
        QFETCH(QString, reference);
        QFETCH(QString, expected);
        const QString s = pathSeparator();
        QCOMPARE(ImageFileName(s + QStringLiteral("cat") + s + QStringLiteral("images"), reference),
                 expected);
    }

    void pageText_data()
    {
        QTest::addColumn<QVariant>("value");
        QTest::addColumn<QString>("expected");
        QTest::newRow("null") << QVariant() << QStringLiteral("&nbsp;");
        QTest::newRow("null text") << QVariant(QMetaType::fromType<QString>()) << QStringLiteral("&nbsp;");
        QTest::newRow("empty") << QVariant(QStringLiteral("")) << QString();
        QTest::newRow("plain") << QVariant(QStringLiteral("בורג M8")) << QStringLiteral("בורג M8");
        QTest::newRow("markup") << QVariant(QStringLiteral("Bolt <M8> & nut"))
                                << QStringLiteral("Bolt &lt;M8&gt; &amp; nut");
        QTest::newRow("quotes") << QVariant(QStringLiteral("12\" 'x'"))
                                << QStringLiteral("12&quot; &#39;x&#39;");
        QTest::newRow("number") << QVariant(12.5) << QStringLiteral("12.5");
        QTest::newRow("entity stays text")
            << QVariant(QStringLiteral("&nbsp;")) << QStringLiteral("&amp;nbsp;");
    }

    void pageText()
    {
        QFETCH(QVariant, value);
        QFETCH(QString, expected);
        QCOMPARE(HTMLText(value), expected);
    }

    void hebrew_data()
    {
        QTest::addColumn<QString>("text");
        QTest::addColumn<bool>("expected");
        QTest::newRow("empty") << QString() << false;
        QTest::newRow("latin, digits, blanks") << QStringLiteral("Bolt M8 100") << false;
        QTest::newRow("alef") << QStringLiteral("x\u05D0") << true;
        QTest::newRow("tav") << QStringLiteral("\u05EA") << true;
        QTest::newRow("final kaf") << QStringLiteral("12 \u05DA") << true;
        QTest::newRow("points only") << QStringLiteral("\u05B0\u05B8\u05BC") << false;
        QTest::newRow("maqaf and geresh") << QStringLiteral("\u05BE\u05F3\u05F4") << false;
        QTest::newRow("yiddish ligature") << QStringLiteral("\u05F0") << false;
        QTest::newRow("null mark") << QStringLiteral("&nbsp;") << false;
    }

    void hebrew()
    {
        QFETCH(QString, text);
        QFETCH(bool, expected);
        QCOMPARE(HasHebrew(text), expected);
    }

    void numbers_data()
    {
        QTest::addColumn<QVariant>("value");
        QTest::addColumn<double>("expected");
        QTest::newRow("null") << QVariant() << 0.0;
        QTest::newRow("double") << QVariant(1234.5) << 1234.5;
        QTest::newRow("integer") << QVariant(qint64(-3)) << -3.0;
        QTest::newRow("numeric text") << QVariant(QStringLiteral(" 7.25 ")) << 7.25;
    }

    void numbers()
    {
        QFETCH(QVariant, value);
        QFETCH(double, expected);
        const auto number = NumOrZero(value);
        QVERIFY(number.isOk());
        QCOMPARE(number.value(), expected);
    }

    void textThatIsNotANumberFails()
    {
        const auto number = NumOrZero(QVariant(QStringLiteral("שקל")));
        QVERIFY(!number.isOk());
        QVERIFY(number.status().description().contains(QStringLiteral("שקל")));
        QVERIFY(!NumOrZero(QVariant(QString())).isOk());
    }

    void fileReferences_data()
    {
        QTest::addColumn<QString>("path");
        QTest::addColumn<QString>("expected");
        QTest::newRow("plain") << QStringLiteral("/cat/images/A12.JPG")
                               << QStringLiteral("/cat/images/A12.JPG");
        QTest::newRow("apostrophe and ampersand")
            << QStringLiteral("/p/l'or & fils.jpg") << QStringLiteral("/p/l&#39;or &amp; fils.jpg");
        QTest::newRow("url marks") << QStringLiteral("/p/50% #2?.png")
                                   << QStringLiteral("/p/50%25 %232%3F.png");
        QTest::newRow("markup") << QStringLiteral("/p/<b>\".png") << QStringLiteral("/p/&lt;b&gt;&quot;.png");
        QTest::newRow("hebrew stays")
            << QStringLiteral("/תמונות/כיסא.png") << QStringLiteral("/תמונות/כיסא.png");
        QTest::newRow("windows path stays")
            << QStringLiteral("c:\\photos\\A12.JPG") << QStringLiteral("c:\\photos\\A12.JPG");
        QTest::newRow("a URL keeps its query and fragment")
            << QStringLiteral("http://host/p.php?id=5&s=1#x")
            << QStringLiteral("http://host/p.php?id=5&amp;s=1#x");
        QTest::newRow("a URL keeps its percent codes")
            << QStringLiteral("https://cdn.example/l'or%20a.png")
            << QStringLiteral("https://cdn.example/l&#39;or%20a.png");
        QTest::newRow("a colon alone is no scheme")
            << QStringLiteral("/p/a:b?.png") << QStringLiteral("/p/a:b%3F.png");
    }

    void fileReferences()
    {
        QFETCH(QString, path);
        QFETCH(QString, expected);
        QCOMPARE(attributeFileReference(path), expected);
    }
};

ZORBIN_TEST_CLASS(FileNamingTest)
#include "FileNamingTest.moc"
