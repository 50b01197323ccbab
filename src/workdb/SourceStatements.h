#pragma once

#include "common/Status.h"

#include <QString>
#include <cstdint>

namespace zorbin {

struct CatalogSettings;

// The statements that the collection steps send to the accounting database, exactly as they
// reach it. Each reads the settings at the moment of the call and has no other effect, so that
// the command line can print what a run would send.

// FillDBItem7: key, sort group, filter, unit, price and currency of the items, with the name
// chosen by CmbItemNameType as ItemDesc and, for picture sources 0 and 2, the picture
// reference as PicFile, limited by the item-range criteria. A fault when the criteria are
// refused or picture source 2 is chosen without a note kind in cmbPicExtraNote.
Result<QString> buildItemStatement(const CatalogSettings &settings);

// FillDBItemPrice: key, price and currency of the items in price list `priceListId`.
Result<QString> buildPriceStatement(const CatalogSettings &settings, std::int32_t priceListId);

// FillDBItemExtraNote: key and text of the items' notes of kind `extraNoteId`.
Result<QString> buildExtraNoteStatement(const CatalogSettings &settings, std::int32_t extraNoteId);

// FillDBItemSort7: every named sort group, whatever the item range.
QString buildSortGroupStatement();

} // namespace zorbin
