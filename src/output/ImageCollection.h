#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

struct RunContext;

// Copies the logo and the picture of every catalog item into the images folder.
Status CollectCatImages(RunContext &context, const QString &imagesFolder, const QString &dbFile);

} // namespace zorbin
