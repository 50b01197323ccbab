#pragma once

#include "common/Status.h"

#include <QString>
#include <QVariant>
#include <cstdint>

namespace zorbin {

struct RunContext;

// The collection steps. Each copies one statement's rows from the accounting database into
// one table of the working database at `pDBFile` (the path CreateWorkDB returned) through the
// copy loop (CopyLoop.h) and returns its failure; a stop request ends the item steps early,
// successfully.

// tItems: the items in the item range, with the name and picture reference the settings choose.
Status FillDBItem7(RunContext &context, const QString &pDBFile);
// tItemPrice<pPriceID> (1 or 2): the items' prices in price list pPriceListID (0 included).
Status FillDBItemPrice(RunContext &context, const QString &pDBFile, std::int16_t pPriceID,
                       std::int32_t pPriceListID);
// tExtraNote<pNoteFieldID> (1 or 2): the items' notes of kind pExtraNoteID.
Status FillDBItemExtraNote(RunContext &context, const QString &pDBFile, std::int16_t pNoteFieldID,
                           std::int32_t pExtraNoteID);
// tItemSort: every named sort group, with no progress display and no stop test.
Status FillDBItemSort7(RunContext &context, const QString &pDBFile);

// A field value as text: `defaultText` for a Null, otherwise the value's text.
QString TextOrDefault(const QVariant &value, const QString &defaultText);

} // namespace zorbin
