#pragma once

#include <QString>
#include <QVariant>

namespace zorbin {

struct CatalogSettings;
struct ConnectionParams;

// Fill the drop-down lists of the settings page that name what the accounting database numbers;
// each entry shows a name and carries the database's number as its item data. Each opens its
// own connection with the given parameters and closes it before returning.
//
// A failure (no connection, a missing table or column, a number that does not convert) is
// silent and ends the filling at once: the lists keep what they held, or the entries added so
// far. When the query has no rows the lists are left exactly as they were.

// `cmbPicExtraNote`, `cmbExtraNote1` and `cmbExtraNote2`: every item note kind with a non-empty
// name, in ascending `NoteID`, from
// "SELECT NoteID, NoteName FROM ExtraNoteNames Where ItemFlag = 1 Order By NoteID".
void FillCmbExtraNote(const ConnectionParams &connection, CatalogSettings &settings);

// `cmbPriceField` and `cmbPriceField2`: first "מחיר מכירה" (the item's own price) with item data
// 0, then every price list with a non-empty name, in the order "SELECT * FROM PriceListNames"
// returns them, with item data `PriceListID`.
void FillCmbPriceField(const ConnectionParams &connection, CatalogSettings &settings);

// A field value as a name: the empty text for Null, otherwise the text without leading and
// trailing blanks.
QString TrimOrEmpty(const QVariant &value);

} // namespace zorbin
