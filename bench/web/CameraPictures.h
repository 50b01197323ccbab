#pragma once

#include "common/Status.h"

#include <QSize>
#include <QString>
#include <QStringList>

namespace zorbin::bench {

// Writes `count` distinct JPEG pictures of `size` pixels into `folder` (kept when already
// there from an earlier run of the benchmark, since making them takes longer than the runs
// measured), and returns their paths.
Result<QStringList> makeCameraPictures(const QString &folder, int count, QSize size);

} // namespace zorbin::bench
