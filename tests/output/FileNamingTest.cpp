// The edges of page and picture names and of the conversions of stored values into page text
// (the golden files show the common cases).
#include "output/FileNaming.h"

#include "platform/Paths.h"
#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;

class FileNamingTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void pageNamesPastSixteenBits()
    {
        QCOMPARE(HTMLFileName(u"/out/zo"_qs, 32768), u"/out/zo032768.htm"_qs);
        QCOMPARE(HTMLFileName(u"/out/zo"_qs, 1234567), u"/out/zo1234567.htm"_qs);
    }

    // The name in the images folder: what follows the platform's separator, and only that.
    void pictureNames()
    {
        const QString s = pathSeparator();
        const QString other = s == QLatin1String("/") ? u"\\"_qs : u"/"_qs;
        const QString images = u"images"_qs + s;
        QCOMPARE(ImageFileName(u"images"_qs, s + u"photos"_qs + s + u"A12.JPG"_qs), images + u"A12.JPG"_qs);
        QCOMPARE(ImageFileName(u"images"_qs, u"A12.JPG"_qs), images + u"A12.JPG"_qs);
        QCOMPARE(ImageFileName(u"images"_qs, u"photos"_qs + s), images);
        QCOMPARE(ImageFileName(u"images"_qs, u"x:A.JPG"_qs), images + u"x:A.JPG"_qs);
        QCOMPARE(ImageFileName(u"images"_qs, u"a"_qs + other + u"b.png"_qs),
                 images + u"a"_qs + other + u"b.png"_qs);
        QCOMPARE(ImageFileName(u"images"_qs, QString()), QString());
    }

    void pageText()
    {
        const std::pair<QVariant, QString> cases[] = {
            {QVariant(), u"&nbsp;"_qs},
            {QVariant(QMetaType::fromType<QString>()), u"&nbsp;"_qs}, // a null text
            {QVariant(u""_qs), QString()},
            {QVariant(u"Bolt <M8> & nut"_qs), u"Bolt &lt;M8&gt; &amp; nut"_qs},
            {QVariant(u"12\" 'x'"_qs), u"12&quot; &#39;x&#39;"_qs},
            {QVariant(u"&nbsp;"_qs), u"&amp;nbsp;"_qs}, // an entity stays text
        };
        for (const auto &[value, expected] : cases)
            QCOMPARE(HTMLText(value), expected);
    }

    // Letters alef to tav; points, maqaf, geresh and ligatures are no letters.
    void hebrew()
    {
        QVERIFY(HasHebrew(u"x\u05D0"_qs));
        QVERIFY(HasHebrew(u"\u05EA"_qs));
        for (const QString &text : {QString(), u"Bolt M8 100"_qs, u"\u05B0\u05B8\u05BC\u05C7"_qs,
                                    u"\u05BE\u05F3\u05F4\u05F0"_qs, u"\u05CF\u05EB"_qs})
            QVERIFY2(!HasHebrew(text), qPrintable(text));
    }

    void fileReferences_data()
    {
        QTest::addColumn<QString>("path");
        QTest::addColumn<QString>("expected");
        QTest::newRow("apostrophe and ampersand")
            << u"/p/l'or & fils.jpg"_qs << u"/p/l&#39;or &amp; fils.jpg"_qs;
        QTest::newRow("url marks") << u"/p/50% #2?.png"_qs << u"/p/50%25 %232%3F.png"_qs;
        QTest::newRow("markup") << u"/p/<b>\".png"_qs << u"/p/&lt;b&gt;&quot;.png"_qs;
        QTest::newRow("hebrew and windows path stay")
            << u"c:\\תמונות\\כיסא.png"_qs << u"c:\\תמונות\\כיסא.png"_qs;
        QTest::newRow("a URL keeps its query and fragment")
            << u"http://host/p.php?id=5&s=1#x"_qs << u"http://host/p.php?id=5&amp;s=1#x"_qs;
        QTest::newRow("a URL keeps its percent codes")
            << u"https://cdn.example/l'or%20a.png"_qs << u"https://cdn.example/l&#39;or%20a.png"_qs;
        QTest::newRow("a colon alone is no scheme") << u"/p/a:b?.png"_qs << u"/p/a:b%3F.png"_qs;
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
