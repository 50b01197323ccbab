#pragma once

#include "common/Status.h"

#include <QString>
#include <QVariant>
#include <functional>
#include <vector>

namespace zorbin {

struct RunContext;

// One column of a collection step's target row: its name in the working table, the source
// column it is made from (read by name; empty for none) and how (nothing: the value as read).
// A conversion runs on the thread that reads the source, unless it reads the settings, which
// belong to the step's thread.
struct CopiedColumn
{
    using Convert = std::function<QVariant(const QVariant &sourceValue, const QString &keyText)>;

    QString target;
    QString source;
    Convert convert;
    bool readsSettings = false;
};

// What a collection step copies: one statement on the accounting database into one table of
// the working database, a target row per source row.
struct CopyPlan
{
    QString statement;
    QString table;
    std::vector<CopiedColumn> columns; // in the order the step writes them
    // The item steps: a row count for the progress protocol (a point every fifth row, the stop
    // request tested there), and rows whose ItemKey reads as the empty text passed over. The
    // sort-group step has neither and adds every row.
    bool itemLoop = true;
};

// The copy loop that the four collection steps share. Opens the accounting database from the
// stored connection parameters, runs the statement, and when it yields rows opens the working
// database at `pDBFile` and adds them. A row the table already holds by its key is dropped
// without a word; the first of several rows with one key stays. Any other failure (connection,
// statement, a value the table refuses, the working database, a read that fails after the
// last row) ends the step with the bar where it was and is returned. A stop request ends it at
// a progress point, successfully. Whatever was written before a stop or a failure stays: rows
// are written in one transaction that is committed before the step returns, whichever way it
// returns.
Status runCopyLoop(RunContext &context, const QString &pDBFile, const CopyPlan &plan);

} // namespace zorbin
