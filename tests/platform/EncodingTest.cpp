// The code page of the catalog files: the encoder against the system's ICU converter, and the
// writer's escaping, line ends, blocks and failures.
#include "platform/ForwardingFileSystem.h"
#include "platform/Windows1255Encoder.h"
#include "platform/Windows1255Writer.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QTemporaryDir>
#include <QTest>
#include <unicode/ucnv.h>
#include <unicode/ucnv_cb.h>

using namespace zorbin;

namespace {

// The local file system, except that every file opened for writing is on a full disk.
class FullDiskFileSystem final : public ForwardingFileSystem
{
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

private:
    QTemporaryDir m_dir;

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
        const QString path = m_dir.filePath(u"page.htm"_qs);
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
        writer.writeLine(u"</td>");
        QByteArray expected(
            "<td>\xF9&quot;\xE7\xA4\xFD &lt;b&gt;&amp;&#39;x&#39;&#128512;&amp;&#33457;&#55357;&lt;"
            "&#55357;</td>\r\n");
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
        auto writer = Windows1255Writer::create(files, m_dir.filePath(u"full.htm"_qs));
        QVERIFY(writer.isOk());
        writer.value()->writeLine(u"x");
        const Status closed = writer.value()->close();
        QVERIFY(!closed.isOk());
        QVERIFY(closed.description().contains(u"No space left on device"_qs));
        QVERIFY(!writer.value()->isOk());
    }
};

ZORBIN_TEST_CLASS(EncodingTest)
#include "EncodingTest.moc"
