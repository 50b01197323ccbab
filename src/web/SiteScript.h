#pragma once

#include <QByteArrayView>

namespace zorbin {

// The site's script: the search box. The box stays hidden without scripts. On the first use
// it loads the search index (SearchIndex.h) with a script element, which works from disk as
// from a web server; then, as the user types, the page's items give way to the entries whose
// name or key holds the text (any letter case), each a link to its item on its page.
// Values reach the page as text, never as markup.
QByteArrayView siteScript();

} // namespace zorbin
