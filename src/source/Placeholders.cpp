// Stand-ins until the accounting-database access is written.
#include "source/ChoiceLists.h"
#include "source/ConnectionStore.h"

namespace zorbin {

void GetRegConnParams(SettingsStore &, ConnectionParams &) {}
void FillCmbExtraNote(const ConnectionParams &, CatalogSettings &) {}
void FillCmbPriceField(const ConnectionParams &, CatalogSettings &) {}

} // namespace zorbin
