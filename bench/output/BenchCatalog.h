#pragma once

#include "common/Status.h"

#include <QString>
#include <QStringList>

namespace zorbin {
struct CatalogSettings;
}

namespace zorbin::bench {

// Writes `count` distinct pictures (PNG and JPEG, of varied sizes, drawn with Qt) into
// `folder`, and a logo; returns their paths, the logo last.
Result<QStringList> makePictures(const QString &folder, int count);

// Creates a working database at `path` with `items` catalog items, item i showing
// pictures[i % pictures.size()], in one transaction.
Status makeWorkDatabase(const QString &path, int items, const QStringList &pictures);

// The catalog settings of the benchmark: 8 rows by 3 columns, a picture line fitted into
// 120 x 90 pixels, four text lines (key, name, price, unit), both bands, the logo.
void useBenchSettings(CatalogSettings &settings, const QString &outputFolder, const QString &logo);

} // namespace zorbin::bench
