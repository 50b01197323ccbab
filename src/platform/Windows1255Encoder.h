#pragma once

#include <QByteArray>
#include <QStringView>

namespace zorbin {

struct Windows1255Table;

// Turns text into the windows-1255 code page of the catalog files. A character the code page
// lacks (an emoji, a Chinese letter) becomes a decimal character reference ("&#128512;"), so
// that a page, stylesheet or list never loses a character. The bytes are those of the system's
// ICU converter with decimal references, which also leaves out the invisible "default
// ignorable" characters that the code page lacks (a zero width space, a variation selector).
//
// Text may be given in pieces: a surrogate pair split between two pieces is still joined.
// Not copyable; one encoder per file.
class Windows1255Encoder
{
public:
    Windows1255Encoder();
    Windows1255Encoder(const Windows1255Encoder &) = delete;
    Windows1255Encoder &operator=(const Windows1255Encoder &) = delete;

    // False when the system's ICU has no windows-1255 converter (then encode() does nothing).
    bool isValid() const { return m_table != nullptr; }

    // Appends the bytes of `text` to `out`. `last` ends the text: a dangling half of a
    // surrogate pair is then written as a character reference too.
    void encode(QStringView text, QByteArray &out, bool last = false);
    // Ends the text given so far, as encode() with `last` and no more text does.
    void finish(QByteArray &out);

    // The whole text at once.
    static QByteArray encoded(QStringView text);

private:
    void encodeFrom(const char16_t *begin, const char16_t *end, QByteArray &out);
    void appendCharacter(char32_t code, QByteArray &out) const;

    const Windows1255Table *m_table = nullptr;
    char16_t m_heldHigh = 0; // the first half of a pair whose second half has not come yet
};

} // namespace zorbin
