#include "web/SearchIndex.h"

#include "web/SiteFile.h"
#include "web/ThumbnailStore.h"

namespace zorbin {

void appendJsonString(QByteArray &out, QStringView text)
{
    static constexpr char Hex[] = "0123456789abcdef";
    out += '"';
    qsizetype run = 0;
    const auto flushRun = [&](qsizetype end) { out += text.sliced(run, end - run).toUtf8(); };
    for (qsizetype i = 0; i < text.size(); ++i) {
        const char16_t c = text[i].unicode();
        // Controls, the quote and backslash, "<" (no "</script" inside a page), and the two
        // line separators that older script engines do not take inside a string.
        if (c >= 0x20 && c != u'"' && c != u'\\' && c != u'<' && c != 0x2028 && c != 0x2029)
            continue;
        flushRun(i);
        out += "\\u";
        out += Hex[(c >> 12) & 0xF];
        out += Hex[(c >> 8) & 0xF];
        out += Hex[(c >> 4) & 0xF];
        out += Hex[c & 0xF];
        run = i + 1;
    }
    flushRun(text.size());
    out += '"';
}

QByteArray searchEntryStart(QStringView key, QStringView name, const Thumbnail *picture)
{
    QByteArray entry = "[";
    appendJsonString(entry, key);
    entry += ',';
    appendJsonString(entry, name);
    entry += ',';
    appendJsonString(entry, picture ? QStringView(picture->file) : QStringView());
    entry += ',' + QByteArray::number(picture ? picture->size.width() : 0) + ',' +
             QByteArray::number(picture ? picture->size.height() : 0);
    return entry;
}

void writeSearchIndexStart(SiteFile &index)
{
    index.writeBytes("window.zorbinIndex = [\n");
}

void writeSearchEntry(SiteFile &index, QByteArrayView start, long long page, long long item, bool first)
{
    if (!first)
        index.writeBytes(",\n");
    index.writeBytes(start);
    index.writeBytes(',' + QByteArray::number(page) + ',' + QByteArray::number(item) + ']');
}

void writeSearchIndexEnd(SiteFile &index)
{
    index.writeBytes("\n];\n");
}

} // namespace zorbin
