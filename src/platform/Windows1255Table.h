#pragma once

#include <cstdint>
#include <vector>

namespace zorbin {

// How the system's ICU windows-1255 converter writes each character, as a table, so that
// encoding costs a look-up rather than a converter call. Built once, on first use, and shared.
struct Windows1255Table
{
    // Beside the bytes 0 to 255: what the converter does with a character the code page lacks.
    static constexpr std::uint16_t Reference = 0x100; // a decimal character reference
    static constexpr std::uint16_t Left = 0x200;      // nothing: ICU leaves out such a character
                                                      // when it is "default ignorable" (U+200B)

    std::vector<std::uint16_t> bmp;     // one entry for each of U+0000 to U+FFFF; surrogates Reference
    std::vector<char32_t> leftAboveBmp; // in order

    // Reference or Left for a character above U+FFFF (the code page has none of them).
    std::uint16_t aboveBmp(char32_t code) const;
};

// Null when the system's ICU has no windows-1255 converter.
const Windows1255Table *windows1255Table();

} // namespace zorbin
