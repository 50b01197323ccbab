#include "platform/Windows1255Encoder.h"

#include <unicode/ucnv.h>
#include <unicode/ucnv_cb.h>

namespace zorbin {

Windows1255Encoder::Windows1255Encoder()
{
    UErrorCode error = U_ZERO_ERROR;
    m_converter = ucnv_open("windows-1255", &error);
    if (U_FAILURE(error)) {
        m_converter = nullptr;
        return;
    }
    ucnv_setFromUCallBack(m_converter, UCNV_FROM_U_CALLBACK_ESCAPE, UCNV_ESCAPE_XML_DEC, nullptr, nullptr,
                          &error);
    if (U_FAILURE(error)) {
        ucnv_close(m_converter);
        m_converter = nullptr;
    }
}

Windows1255Encoder::~Windows1255Encoder()
{
    if (m_converter)
        ucnv_close(m_converter);
}

void Windows1255Encoder::encode(QStringView text, QByteArray &out, bool last)
{
    if (!m_converter)
        return;
    static_assert(sizeof(UChar) == sizeof(QChar));
    const auto *source = reinterpret_cast<const UChar *>(text.utf16());
    const UChar *const sourceEnd = source + text.size();
    // Most characters take one byte; a character reference takes up to ten.
    qsizetype written = out.size();
    qsizetype room = text.size() + 16;
    for (;;) {
        out.resize(written + room);
        char *target = out.data() + written;
        UErrorCode error = U_ZERO_ERROR;
        ucnv_fromUnicode(m_converter, &target, out.data() + out.size(), &source, sourceEnd, nullptr, last,
                         &error);
        written = target - out.data();
        if (error != U_BUFFER_OVERFLOW_ERROR)
            break;
        room = (sourceEnd - source) * 10 + 16;
    }
    out.resize(written);
}

QByteArray Windows1255Encoder::encoded(QStringView text)
{
    Windows1255Encoder encoder;
    QByteArray bytes;
    encoder.encode(text, bytes, true);
    return bytes;
}

} // namespace zorbin
