#pragma once

#include "common/Status.h"

#include <QString>
#include <cstdint>
#include <span>

namespace zorbin {

class ChoiceList;
struct CatalogSettings;
struct RunContext;

// How a collection that could start ended.
struct CollectionReport
{
    // The failure of the step that ended the collection early; the later steps did not run, and
    // the working database holds what the steps before it, and the failed step up to its
    // failure, wrote. Success when every step ran.
    Status stepFailure;
    // A stop request cut the collection short: each step that tests it ended at its first
    // progress point after the request.
    bool stopped = false;
};

// The collection run: a fresh working database, then items, sort groups, price lists and
// extra notes, with the step's text in the status line. Sets WorkDBFile. Fails before any step
// when the collection cannot start: another collection holds the working database, it cannot
// be created, or a price list or extra note is to be collected without one chosen.
Result<CollectionReport> BuildAndCollectData(RunContext &context);

// A price list or extra note that a collection gathers when its check box is ticked.
struct ChosenList
{
    bool CatalogSettings::*collect;
    ChoiceList CatalogSettings::*list;
    bool price;             // a price list (FillDBItemPrice), else an extra note (FillDBItemExtraNote)
    std::int16_t digit;     // which of the two: 1 or 2
    const char16_t *status; // the status line while it is collected
    const char16_t *name;   // how the data tab names it
};

// The four price lists and extra notes, in the order of the collection.
std::span<const ChosenList> chosenLists();

// The fault of a run that is to collect a price list or an extra note (`what`, as the data tab
// names it) while its list has no entry selected.
Status nothingChosen(const QString &what);

} // namespace zorbin
