// The code page of the catalog files and the number and date formats.
#include "platform/ValueFormat.h"
#include "platform/Windows1255Encoder.h"
#include "platform/Windows1255Writer.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QLocale>
#include <QTemporaryDir>
#include <QTest>
#include <limits>
#include <unicode/ucnv.h>
#include <unicode/ucnv_cb.h>

using namespace zorbin;

namespace {

// A device that refuses every write, as a full disk does.
class FullDevice final : public QIODevice
{
public:
    FullDevice()
    {
        open(QIODevice::WriteOnly);
        setErrorString(QStringLiteral("No space left on device"));
    }

protected:
    qint64 readData(char *, qint64) override { return -1; }
    qint64 writeData(const char *, qint64) override { return -1; }
};

// The local file system, except that every file opened for writing is on a full disk.
class FullDiskFileSystem final : public FileSystem
{
public:
    bool fileExists(const QString &path) const override { return real().fileExists(path); }
    bool folderExists(const QString &path) const override { return real().folderExists(path); }
    std::optional<QString> findFile(const QString &path) const override { return real().findFile(path); }
    Status makeFolder(const QString &path) override { return real().makeFolder(path); }
    Status removeFile(const QString &path) override { return real().removeFile(path); }
    Status copyFile(const QString &from, const QString &to) override { return real().copyFile(from, to); }
    QStringList fileNames(const QString &folder) const override { return real().fileNames(folder); }
    Result<std::unique_ptr<QIODevice>> openForReading(const QString &path) const override
    {
        return real().openForReading(path);
    }
    Result<std::unique_ptr<QIODevice>> openForWriting(const QString &) override
    {
        return std::unique_ptr<QIODevice>(std::make_unique<FullDevice>());
    }
    Result<std::unique_ptr<QIODevice>> openForAppending(const QString &path) override
    {
        return openForWriting(path);
    }

private:
    static FileSystem &real() { return localFileSystem(); }
};

// The system's ICU converter with decimal references for what the code page lacks: what the
// table-driven encoder must give, byte for byte.
QByteArray icuEncoded(QStringView text)
{
    UErrorCode error = U_ZERO_ERROR;
    UConverter *converter = ucnv_open("windows-1255", &error);
    ucnv_setFromUCallBack(converter, UCNV_FROM_U_CALLBACK_ESCAPE, UCNV_ESCAPE_XML_DEC, nullptr, nullptr,
                          &error);
    QByteArray bytes(text.size() * 10 + 16, Qt::Uninitialized);
    const int32_t length = ucnv_fromUChars(converter, bytes.data(), static_cast<int32_t>(bytes.size()),
                                           reinterpret_cast<const UChar *>(text.utf16()),
                                           static_cast<int32_t>(text.size()), &error);
    ucnv_close(converter);
    bytes.truncate(U_SUCCESS(error) ? length : 0);
    return bytes;
}

// Every text of up to `length` code units made of `units`.
QStringList allTexts(const QList<char16_t> &units, int length)
{
    QStringList texts{QString()};
    QStringList shorter = texts;
    for (int i = 0; i < length; ++i) {
        QStringList longer;
        for (const QString &text : std::as_const(shorter)) {
            for (const char16_t unit : units)
                longer << text + QChar(unit);
        }
        texts += longer;
        shorter = longer;
    }
    return texts;
}

} // namespace

class EncodingTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void codePage_data()
    {
        QTest::addColumn<QString>("text");
        QTest::addColumn<QByteArray>("expected");
        QTest::newRow("ascii") << QStringLiteral("<td class=L1>") << QByteArray("<td class=L1>");
        QTest::newRow("alef to tav") << QStringLiteral("\u05D0\u05DA\u05EA") << QByteArray("\xE0\xEA\xFA");
        QTest::newRow("points, shekel, euro, marks")
            << QStringLiteral("\u05B8\u20AA\u20AC\u200E\u200F") << QByteArray("\xC8\xA4\x80\xFD\xFE");
        QTest::newRow("emoji") << QStringLiteral("A\U0001F600B") << QByteArray("A&#128512;B");
        QTest::newRow("chinese") << QStringLiteral("\u82B1\u74F6") << QByteArray("&#33457;&#29942;");
        QTest::newRow("lone surrogate") << QString(QChar(0xD83D)) << QByteArray("&#55357;");
        QTest::newRow("invisible") << QStringLiteral("a\u200Bb\U000E0041c\uFE0F") << QByteArray("abc");
    }

    void codePage()
    {
        QFETCH(QString, text);
        QFETCH(QByteArray, expected);
        QCOMPARE(Windows1255Encoder::encoded(text), expected);
    }

    void surrogatePairSplitBetweenPieces()
    {
        const QString text = QStringLiteral("x\U0001F600y");
        Windows1255Encoder encoder;
        QByteArray bytes;
        encoder.encode(QStringView(text).left(2), bytes);
        encoder.encode(QStringView(text).mid(2), bytes, true);
        QCOMPARE(bytes, QByteArray("x&#128512;y"));
    }

    void everyCharacterAsIcuHasIt()
    {
        QString text;
        for (char32_t code = 1; code <= QChar::LastValidCodePoint; ++code) {
            if (!QChar::isSurrogate(code))
                text += QString::fromUcs4(&code, 1);
        }
        const QByteArray expected = icuEncoded(text);
        QVERIFY(!expected.isEmpty());
        QCOMPARE(Windows1255Encoder::encoded(text), expected);
    }

    // Pairs, lone halves and a half next to markup or Hebrew, whole and cut into two pieces
    // at every place.
    void surrogateHalvesAsIcuHasThem()
    {
        const QList<char16_t> units{u'a', u'&', 0x05E9, 0x05B8, 0x200B, 0x82B1, 0xD83D, 0xDE00, 0xDB40};
        for (const QString &text : allTexts(units, 4)) {
            const QByteArray expected = icuEncoded(text);
            QCOMPARE(Windows1255Encoder::encoded(text), expected);
            for (qsizetype cut = 0; cut <= text.size(); ++cut) {
                Windows1255Encoder encoder;
                QByteArray bytes;
                encoder.encode(QStringView(text).left(cut), bytes);
                encoder.encode(QStringView(text).mid(cut), bytes, true);
                QCOMPARE(bytes, expected);
            }
        }
    }

    void writerEscapesValues()
    {
        QTemporaryDir dir;
        const QString path = dir.filePath(QStringLiteral("values.htm"));
        auto writer = Windows1255Writer::create(localFileSystem(), path);
        QVERIFY(writer.isOk());
        writer.value()->write(u"<td>");
        writer.value()->writeEscaped(QStringLiteral("\u05E9\"\u05D7 <b>&'x'"));
        writer.value()->writeEscaped(QStringLiteral("\U0001F600&\u82B1"));
        // A lone first half of a pair ends before the reference of the markup after it.
        writer.value()->writeEscaped(QString(QChar(0xD83D)) + QStringLiteral("<"));
        writer.value()->writeEscaped(QString(QChar(0xD83D)));
        writer.value()->writeLine(u"</td>");
        QVERIFY(writer.value()->close().isOk());
        QCOMPARE(test::readFile(path), QByteArray("<td>\xF9&quot;\xE7 &lt;b&gt;&amp;&#39;x&#39;"
                                                  "&#128512;&amp;&#33457;&#55357;&lt;&#55357;</td>\r\n"));
    }

    void writerEndsLinesWithCrLfAndReplacesTheFile()
    {
        QTemporaryDir dir;
        QVERIFY(dir.isValid());
        const QString path = dir.filePath(QStringLiteral("page.htm"));
        test::writeFile(path, QByteArray(100000, 'x'));
        auto writer = Windows1255Writer::create(localFileSystem(), path);
        QVERIFY(writer.isOk());
        writer.value()->write(u"<p>");
        writer.value()->write(QStringLiteral("\u05E9\u05DC\u05D5\u05DD"));
        writer.value()->writeLine(u"</p>");
        writer.value()->writeLine(QStringLiteral("\U0001F600"));
        writer.value()->endLine();
        QVERIFY(writer.value()->close().isOk());
        QCOMPARE(test::readFile(path), QByteArray("<p>\xF9\xEC\xE5\xED</p>\r\n&#128512;\r\n\r\n"));
    }

    void writerHandlesLongTexts()
    {
        QTemporaryDir dir;
        const QString path = dir.filePath(QStringLiteral("long.htm"));
        auto writer = Windows1255Writer::create(localFileSystem(), path);
        QVERIFY(writer.isOk());
        QByteArray expected;
        for (int i = 0; i < 20000; ++i) {
            writer.value()->writeLine(QStringLiteral("\u05D0\U0001F600%1").arg(i));
            expected += "\xE0&#128512;" + QByteArray::number(i) + "\r\n";
        }
        QVERIFY(writer.value()->close().isOk());
        QCOMPARE(writer.value()->bytesWritten(), qint64(expected.size()));
        QCOMPARE(test::readFile(path), expected);
    }

    void fileThatCannotBeReplacedFails()
    {
        QTemporaryDir dir;
        const QString path = dir.filePath(QStringLiteral("busy.htm"));
        test::FaultyFileSystem files;
        files.failingPaths << path;
        const auto writer = Windows1255Writer::create(files, path);
        QVERIFY(!writer.isOk());
        QVERIFY(writer.status().description().contains(path));
    }

    void writeFailureIsReported()
    {
        QTemporaryDir dir;
        FullDiskFileSystem files;
        auto writer = Windows1255Writer::create(files, dir.filePath(QStringLiteral("full.htm")));
        QVERIFY(writer.isOk());
        writer.value()->writeLine(u"x");
        const Status closed = writer.value()->close();
        QVERIFY(!closed.isOk());
        QVERIFY(closed.description().contains(QStringLiteral("No space left on device")));
    }

    void amounts_data()
    {
        QTest::addColumn<double>("value");
        QTest::addColumn<QString>("expected");
        QTest::newRow("thousands") << 1234.5 << QStringLiteral("1,234.50");
        QTest::newRow("zero") << 0.0 << QStringLiteral("0.00");
        QTest::newRow("negative") << -3.0 << QStringLiteral("-3.00");
        QTest::newRow("below one") << 0.07 << QStringLiteral("0.07");
        QTest::newRow("million") << 1000000.0 << QStringLiteral("1,000,000.00");
        QTest::newRow("negative thousands") << -98765.432 << QStringLiteral("-98,765.43");
        QTest::newRow("half cent up") << 0.125 << QStringLiteral("0.13");
        // Halves that a double holds a hair below the half (1.00499999999999989...).
        QTest::newRow("typed half cent 1.005") << 1.005 << QStringLiteral("1.01");
        QTest::newRow("typed half cent 0.285") << 0.285 << QStringLiteral("0.29");
        QTest::newRow("typed negative half cent") << -1.005 << QStringLiteral("-1.01");
        QTest::newRow("just below a half cent") << 1.0049 << QStringLiteral("1.00");
        QTest::newRow("below a cent") << 0.004 << QStringLiteral("0.00");
        QTest::newRow("largest exact") << 9999999999999.99 << QStringLiteral("9,999,999,999,999.99");
        QTest::newRow("rounds up to a thousand") << 999.999 << QStringLiteral("1,000.00");
        QTest::newRow("tiny negative has no sign") << -0.001 << QStringLiteral("0.00");
        QTest::newRow("huge") << 123456789012345.0 << QStringLiteral("123,456,789,012,345.00");
        // Typed half cents whose doubles lie a hair below the half.
        QTest::newRow("typed half cent") << 2.675 << QStringLiteral("2.68");
        QTest::newRow("typed half cent below one") << 0.285 << QStringLiteral("0.29");
        QTest::newRow("typed half cent with carry") << 1.005 << QStringLiteral("1.01");
        QTest::newRow("negative typed half cent") << -2.675 << QStringLiteral("-2.68");
        QTest::newRow("just below a half cent") << 0.0049999999 << QStringLiteral("0.00");
        // A corrupt price far beyond any amount of money is printed, not overrun.
        QTest::newRow("beyond every price") << -1e40
                                            << QStringLiteral("-10,000,000,000,000,000,000,000,000,000,000,"
                                                              "000,000,000.00");
        QTest::newRow("largest double") << std::numeric_limits<double>::max()
                                        << QStringLiteral("179,769,313,486,232") +
                                               QStringLiteral(",000").repeated(98) + QStringLiteral(".00");
    }

    void amounts()
    {
        QFETCH(double, value);
        QFETCH(QString, expected);
        QCOMPARE(formatAmount(value, Separators()), expected);
    }

    void amountsWithOtherSeparators()
    {
        Separators separators;
        separators.group = QStringLiteral(".");
        separators.decimal = QStringLiteral(",");
        QCOMPARE(formatAmount(1234567.891, separators), QStringLiteral("1.234.567,89"));
    }

    void dates()
    {
        QCOMPARE(formatDate(QDate(2024, 3, 5), Separators()), QStringLiteral("05/03/2024"));
        Separators dotted;
        dotted.date = QStringLiteral(".");
        QCOMPARE(formatDate(QDate(999, 12, 31), dotted), QStringLiteral("31.12.0999"));
    }

    void systemSeparators()
    {
        const QLocale saved;
        QLocale::setDefault(QLocale::c());
        const Separators c = Separators::ofSystem();
        QCOMPARE(c.group, QStringLiteral(","));
        QCOMPARE(c.decimal, QStringLiteral("."));
        QCOMPARE(c.date, QStringLiteral("/"));
        QLocale::setDefault(QLocale(QLocale::German, QLocale::Germany));
        const Separators german = Separators::ofSystem();
        QCOMPARE(german.group, QStringLiteral("."));
        QCOMPARE(german.decimal, QStringLiteral(","));
        QCOMPARE(german.date, QStringLiteral("."));
        QLocale::setDefault(QLocale(QLocale::Hebrew, QLocale::Israel));
        const Separators hebrew = Separators::ofSystem();
        QCOMPARE(hebrew.group, QStringLiteral(","));
        QCOMPARE(hebrew.decimal, QStringLiteral("."));
        QLocale::setDefault(saved);
    }

    void oneDecimal_data()
    {
        QTest::addColumn<double>("value");
        QTest::addColumn<QString>("expected");
        QTest::newRow("thirds") << 100.0 / 3 << QStringLiteral("33.3");
        QTest::newRow("whole") << 100.0 / 1 << QStringLiteral("100.0");
        QTest::newRow("quarter") << 100.0 / 4 << QStringLiteral("25.0");
        QTest::newRow("half away from zero") << 100.0 / 16 << QStringLiteral("06.3");
        QTest::newRow("two thirds") << 100.0 / 1.5 << QStringLiteral("66.7");
        QTest::newRow("small") << 100.0 / 999 << QStringLiteral("00.1");
    }

    void oneDecimal()
    {
        QFETCH(double, value);
        QFETCH(QString, expected);
        QCOMPARE(formatOneDecimal(value), expected);
    }
};

ZORBIN_TEST_CLASS(EncodingTest)
#include "EncodingTest.moc"
