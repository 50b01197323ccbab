#pragma once

#include <QLatin1StringView>

namespace zorbin {

// The character reference that stands for a markup character in page text ("&" gives
// "&amp;", "<" "&lt;", ">" "&gt;", "\"" "&quot;", "'" "&#39;"); empty for every other character.
constexpr QLatin1StringView htmlReference(char16_t c)
{
    switch (c) {
    case u'&':
        return QLatin1StringView("&amp;");
    case u'<':
        return QLatin1StringView("&lt;");
    case u'>':
        return QLatin1StringView("&gt;");
    case u'"':
        return QLatin1StringView("&quot;");
    case u'\'':
        return QLatin1StringView("&#39;");
    default:
        return {};
    }
}

} // namespace zorbin
