#include "platform/Windows1255Encoder.h"

#include "platform/Windows1255Table.h"

#include <QChar>
#include <charconv>
#include <utility>

namespace zorbin {
namespace {

void appendReference(char32_t code, QByteArray &out)
{
    char digits[16];
    const auto end = std::to_chars(digits, digits + sizeof digits, static_cast<std::uint32_t>(code)).ptr;
    out.append("&#", 2).append(digits, end - digits).append(';');
}

} // namespace

Windows1255Encoder::Windows1255Encoder() : m_table(windows1255Table()) {}

void Windows1255Encoder::encode(QStringView text, QByteArray &out, bool last)
{
    if (!m_table)
        return;
    const char16_t *begin = text.utf16();
    const char16_t *const end = begin + text.size();
    if (m_heldHigh && begin != end) {
        const char16_t high = std::exchange(m_heldHigh, 0);
        if (QChar::isLowSurrogate(*begin)) {
            appendCharacter(QChar::surrogateToUcs4(high, *begin), out);
            ++begin;
        } else {
            appendReference(high, out);
        }
    }
    encodeFrom(begin, end, out);
    if (last)
        finish(out);
}

void Windows1255Encoder::finish(QByteArray &out)
{
    if (m_heldHigh)
        appendReference(std::exchange(m_heldHigh, 0), out);
}

void Windows1255Encoder::encodeFrom(const char16_t *begin, const char16_t *end, QByteArray &out)
{
    // Nearly every character takes one byte: the bytes are written in place, and the room is
    // made anew only after a character that takes more or none.
    qsizetype written = out.size();
    out.resize(written + (end - begin));
    char *target = out.data() + written;
    const std::uint16_t *const bytes = m_table->bmp.data();
    for (const char16_t *c = begin; c != end; ++c) {
        if (*c < 0x80) {
            *target++ = static_cast<char>(*c);
            continue;
        }
        if (const std::uint16_t byte = bytes[*c]; byte <= 0xFF) {
            *target++ = static_cast<char>(byte);
            continue;
        }
        char32_t code = *c;
        if (QChar::isHighSurrogate(*c)) {
            if (c + 1 == end) {
                m_heldHigh = *c;
                break;
            }
            if (QChar::isLowSurrogate(c[1])) {
                code = QChar::surrogateToUcs4(c[0], c[1]);
                ++c;
            }
        }
        out.truncate(target - out.data());
        if (code > 0xFFFF)
            appendCharacter(code, out);
        else if (bytes[code] == Windows1255Table::Reference)
            appendReference(code, out);
        written = out.size();
        out.resize(written + (end - c - 1));
        target = out.data() + written;
    }
    out.truncate(target - out.data());
}

// A character above U+FFFF: the code page has none.
void Windows1255Encoder::appendCharacter(char32_t code, QByteArray &out) const
{
    if (m_table->aboveBmp(code) == Windows1255Table::Reference)
        appendReference(code, out);
}

QByteArray Windows1255Encoder::encoded(QStringView text)
{
    Windows1255Encoder encoder;
    QByteArray bytes;
    encoder.encode(text, bytes, true);
    return bytes;
}

} // namespace zorbin
