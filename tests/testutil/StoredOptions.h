#pragma once

#include "model/CatalogSettings.h"
#include "model/OptionTable.h"

#include <QTest>

namespace zorbin::test {

// Sets the option stored under `key` from a stored text, as a load from the settings store does.
inline void setStored(CatalogSettings &settings, const QString &key, const QString &text)
{
    const StoredOption *option = findStoredOption(key);
    QVERIFY2(option && option->apply(settings, text), qPrintable(key + QStringLiteral("=") + text));
}

} // namespace zorbin::test
