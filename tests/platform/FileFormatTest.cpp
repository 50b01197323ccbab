// How the catalog files are written: the code page (the encoder against the system's ICU
// converter, and the writer's escaping, line ends, blocks and failures) and the number and date
// formats with the system's separators.
#include "platform/ForwardingFileSystem.h"
#include "platform/ValueFormat.h"
#include "platform/Windows1255Encoder.h"
#include "platform/Windows1255Writer.h"
#include "testutil/EdgeOfMemory.h"
#include "testutil/TestFiles.h"

#include <QLocale>
#include <QTemporaryDir>
#include <QTest>
#include <limits>
#include <unicode/ucnv.h>
#include <unicode/ucnv_cb.h>

using namespace zorbin;

namespace {

// A device on a full disk: it opens, and every write fails.
class FullDevice final : public QIODevice
{
public:
    FullDevice()
    {
        open(WriteOnly);
        setErrorString(u"No space left on device"_qs);
    }
    qint64 readData(char *, qint64) override { return -1; }
    qint64 writeData(const char *, qint64) override { return -1; }
};

// The local file system, except that every file opened for writing is on a full disk.
class FullDiskFileSystem final : public ForwardingFileSystem
{
public:
    Result<std::unique_ptr<QIODevice>> openForWriting(const QString &) override
    {
        return std::unique_ptr<QIODevice>(std::make_unique<FullDevice>());
    }
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
    for (qsizetype from = 0; length-- > 0;) {
        const qsizetype to = texts.size();
        for (qsizetype i = from; i < to; ++i) {
            for (const char16_t unit : units)
                texts << texts.at(i) + QChar(unit);
        }
        from = to;
    }
    return texts;
}

} // namespace

class FileFormatTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
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

    // Values escaped, lines ending in CR LF, a page longer than the writer's block of 256 kB
    // replacing a longer file.
    void writer()
    {
        QTemporaryDir folder;
        const QString path = folder.filePath(u"page.htm"_qs);
        test::writeFile(path, QByteArray(1 << 20, 'x'));
        auto created = Windows1255Writer::create(localFileSystem(), path);
        QVERIFY(created.isOk());
        Windows1255Writer &writer = *created.value();
        writer.write(u"<td>");
        writer.writeEscaped(u"\u05E9\"\u05D7\u20AA\u200E <b>&'x'"_qs);
        writer.writeEscaped(u"\U0001F600&\u82B1"_qs);
        // A lone first half of a pair ends before the reference of the markup after it.
        writer.writeEscaped(QString(QChar(0xD83D)) + u"<"_qs);
        writer.writeEscaped(QString(QChar(0xD83D)));
        for (const QString &edge : test::atEdgesOfMemory(u"a>"_qs)) // no read past either end
            writer.writeEscaped(edge);
        writer.writeLine(u"</td>");
        QByteArray expected(
            "<td>\xF9&quot;\xE7\xA4\xFD &lt;b&gt;&amp;&#39;x&#39;&#128512;&amp;&#33457;&#55357;&lt;"
            "&#55357;a&gt;a&gt;</td>\r\n");
        for (int i = 0; i < 20000; ++i) {
            writer.write(u"<p>");
            writer.writeLine(u"\u05D0\U0001F600%1"_qs.arg(i));
            expected += "<p>\xE0&#128512;" + QByteArray::number(i) + "\r\n";
        }
        writer.endLine();
        expected += "\r\n";
        QVERIFY(writer.close().isOk());
        QCOMPARE(writer.bytesWritten(), qint64(expected.size()));
        QCOMPARE(test::readFile(path), expected);
    }

    void writeFailureIsReported()
    {
        FullDiskFileSystem files;
        auto writer = Windows1255Writer::create(files, u"full.htm"_qs);
        QVERIFY(writer.isOk());
        writer.value()->writeLine(u"x");
        const Status closed = writer.value()->close();
        QVERIFY(!closed.isOk());
        QVERIFY2(closed.description().contains(u"No space left on device"_qs),
                 qPrintable(closed.description()));
        QVERIFY(!writer.value()->isOk());
    }

    // The golden catalogs show the common amounts, the date and the C locale's separators.
    void amounts()
    {
        const std::pair<double, QString> cases[] = {
            {-98765.432, u"-98,765.43"_qs},
            {0.125, u"0.13"_qs}, // a half cent away from zero
            // Typed half cents whose doubles lie a hair below the half (2.67499999999999982...).
            {2.675, u"2.68"_qs},
            {0.285, u"0.29"_qs},
            {1.005, u"1.01"_qs},
            {-2.675, u"-2.68"_qs},
            {1.0049, u"1.00"_qs},
            {9999999999999.99, u"9,999,999,999,999.99"_qs},
            {999.999, u"1,000.00"_qs},
            {-0.001, u"0.00"_qs}, // no sign when it rounds to zero
            // A corrupt price far beyond any amount of money is printed, not overrun.
            {-1e40, u"-10,000,000,000,000,000,000,000,000,000,000,000,000,000.00"_qs},
            {std::numeric_limits<double>::max(),
             u"179,769,313,486,232"_qs + u",000"_qs.repeated(98) + u".00"_qs},
        };
        for (const auto &[value, expected] : cases)
            QCOMPARE(formatAmount(value, Separators()), expected);
    }

    // The system's separators, and amounts and dates written with them.
    void systemSeparators()
    {
        const std::pair<QLocale, QString> cases[] = {
            {QLocale(QLocale::German, QLocale::Germany), u"1.234.567,89 31.12.0999"_qs},
            {QLocale(QLocale::Hebrew, QLocale::Israel), u"1,234,567.89 31.12.0999"_qs},
        };
        const QLocale saved;
        for (const auto &[locale, expected] : cases) {
            QLocale::setDefault(locale);
            const Separators separators = Separators::ofSystem();
            QLocale::setDefault(saved);
            QCOMPARE(formatAmount(1234567.891, separators) + u' ' +
                         formatDate(QDate(999, 12, 31), separators),
                     expected);
        }
    }

    // The stylesheet's percentages beyond those of the golden catalogs.
    void oneDecimal()
    {
        QCOMPARE(formatOneDecimal(100.0 / 16), u"06.3"_qs); // a half away from zero
        QCOMPARE(formatOneDecimal(100.0 / 1.5), u"66.7"_qs);
        QCOMPARE(formatOneDecimal(100.0 / 999), u"00.1"_qs);
        QCOMPARE(formatOneDecimal(0.0), u"00.0"_qs);
    }
};

QTEST_GUILESS_MAIN(FileFormatTest)
#include "FileFormatTest.moc"
