#pragma once

namespace zorbin {

struct CatalogSettings;
struct ConnectionParams;

// Fill the source-dependent drop-down lists from the accounting database. A failure is silent:
// the lists keep what they held.
void FillCmbExtraNote(const ConnectionParams &connection, CatalogSettings &settings);
void FillCmbPriceField(const ConnectionParams &connection, CatalogSettings &settings);

} // namespace zorbin
