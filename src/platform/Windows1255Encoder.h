#pragma once

#include <QByteArray>
#include <QStringView>

struct UConverter;

namespace zorbin {

// Turns text into the windows-1255 code page of the catalog files. A character the code page
// lacks (an emoji, a Chinese letter) becomes a decimal character reference ("&#128512;"), so
// that a page, stylesheet or list never loses a character.
//
// Text may be given in pieces: a surrogate pair split between two pieces is still joined.
// Not copyable; one encoder per file.
class Windows1255Encoder
{
public:
    Windows1255Encoder();
    ~Windows1255Encoder();
    Windows1255Encoder(const Windows1255Encoder &) = delete;
    Windows1255Encoder &operator=(const Windows1255Encoder &) = delete;

    // False when the system's ICU has no windows-1255 converter (then encode() does nothing).
    bool isValid() const { return m_converter != nullptr; }

    // Appends the bytes of `text` to `out`. `last` ends the text: a dangling half of a
    // surrogate pair is then written as a character reference too.
    void encode(QStringView text, QByteArray &out, bool last = false);

    // The whole text at once.
    static QByteArray encoded(QStringView text);

private:
    UConverter *m_converter = nullptr;
};

} // namespace zorbin
