#pragma once

#include "workdb/WriteOutcome.h"

#include <QStringList>
#include <QVariant>
#include <span>
#include <vector>

struct sqlite3;
struct sqlite3_stmt;

namespace zorbin {

class WorkDatabase;

// Adds rows to one table of the working database, the named columns in the given order (the
// others take their defaults: Null, and false for Include). Values are bound as they are:
// a null QVariant writes Null, numbers stay numbers, a bool writes -1 or 0, anything else is
// written as its text; the table's own rules then accept or refuse the row.
//
// Borrows the database, which must outlive the writer. Rows are written straight through the
// engine, without Qt's per-statement work: the collection writes hundreds of thousands.
class RowWriter
{
public:
    RowWriter(WorkDatabase &database, const QString &table, const QStringList &columns);
    ~RowWriter();

    RowWriter(const RowWriter &) = delete;
    RowWriter &operator=(const RowWriter &) = delete;

    // Why the statement could not be prepared (an unknown table or column); empty when ready.
    const QString &prepareError() const { return m_prepareError; }

    // One row: exactly one value per column given to the constructor.
    WriteOutcome write(std::span<const QVariant> values);

private:
    sqlite3 *m_handle = nullptr;
    sqlite3_stmt *m_statement = nullptr;
    int m_columnCount = 0;
    std::vector<QByteArray> m_texts; // the UTF-8 texts bound to the statement, one per column
    QString m_prepareError;
};

} // namespace zorbin
