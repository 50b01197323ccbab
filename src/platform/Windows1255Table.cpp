#include "platform/Windows1255Table.h"

#include <QChar>
#include <algorithm>
#include <memory>
#include <unicode/ucnv.h>

namespace zorbin {
namespace {

// The only characters above U+FFFF that ICU's converters leave out rather than reference
// are within these; which of them they leave out depends on the ICU version, so each is asked.
constexpr char32_t LeftRanges[][2] = {{0x1BCA0, 0x1BCA3}, {0x1D173, 0x1D17A}, {0xE0000, 0xE0FFF}};

// The converter with the stop callback: a character the code page lacks fails instead of
// being substituted, and one that ICU leaves out comes back as no bytes.
std::uint16_t converted(UConverter *converter, char32_t code)
{
    UChar units[2];
    int32_t length = 0;
    if (code > 0xFFFF) {
        units[length++] = QChar::highSurrogate(code);
        units[length++] = QChar::lowSurrogate(code);
    } else {
        units[length++] = static_cast<UChar>(code);
    }
    char bytes[8];
    UErrorCode error = U_ZERO_ERROR;
    ucnv_resetFromUnicode(converter);
    const int32_t written = ucnv_fromUChars(converter, bytes, sizeof bytes, units, length, &error);
    if (U_FAILURE(error) || written > 1)
        return Windows1255Table::Reference;
    return written == 0 ? Windows1255Table::Left : static_cast<unsigned char>(bytes[0]);
}

std::unique_ptr<Windows1255Table> buildTable()
{
    UErrorCode error = U_ZERO_ERROR;
    UConverter *converter = ucnv_open("windows-1255", &error);
    if (U_FAILURE(error))
        return nullptr;
    ucnv_setFromUCallBack(converter, UCNV_FROM_U_CALLBACK_STOP, nullptr, nullptr, nullptr, &error);
    auto table = std::make_unique<Windows1255Table>();
    table->bmp.resize(0x10000);
    for (char32_t code = 0; code < 0x10000; ++code)
        table->bmp[code] =
            QChar::isSurrogate(code) ? Windows1255Table::Reference : converted(converter, code);
    for (const auto &range : LeftRanges) {
        for (char32_t code = range[0]; code <= range[1]; ++code) {
            if (converted(converter, code) == Windows1255Table::Left)
                table->leftAboveBmp.push_back(code);
        }
    }
    ucnv_close(converter);
    return table;
}

} // namespace

std::uint16_t Windows1255Table::aboveBmp(char32_t code) const
{
    return std::binary_search(leftAboveBmp.begin(), leftAboveBmp.end(), code) ? Left : Reference;
}

const Windows1255Table *windows1255Table()
{
    static const std::unique_ptr<Windows1255Table> table = buildTable();
    return table.get();
}

} // namespace zorbin
