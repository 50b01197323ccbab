#pragma once

#include "workdb/WorkValue.h"
#include "workdb/WriteOutcome.h"

#include <QStringList>
#include <QVariant>
#include <span>
#include <vector>

struct sqlite3;
struct sqlite3_stmt;

#include <cstddef>

namespace zorbin {

class WorkDatabase;

// Adds rows to one table of the working database, the named columns in the given order (the
// others take their defaults: Null, and false for Include). Values are written as
// WorkValue::from() makes them: a null QVariant writes Null, numbers stay numbers, a bool
// writes -1 or 0, anything else is written as its text; the table's own rules then accept or
// refuse the row.
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
    WriteOutcome write(std::span<const WorkValue> values);

    // Up to MaxRowsAtOnce rows, each one value per column, with the effect of writing them
    // one by one and passing over each row the table refuses as a duplicate key: the outcome
    // is the first other refusal, `failedRow` its row, and no row after it is written. One
    // statement writes them all (a fifth of the work per row) unless the engine refuses it;
    // then nothing of it was written and the rows are written one by one.
    static constexpr std::size_t MaxRowsAtOnce = 5;
    using Row = std::span<const WorkValue>;
    WriteOutcome writeSkippingDuplicates(std::span<const Row> rows, std::size_t *failedRow);

private:
    sqlite3_stmt *statementFor(std::size_t rows);
    WriteOutcome step(sqlite3_stmt *statement, std::span<const Row> rows);

    sqlite3 *m_handle = nullptr;
    QString m_table;
    QStringList m_columns;
    sqlite3_stmt *m_statements[MaxRowsAtOnce] = {}; // [n - 1] inserts n rows; made when first needed
    int m_columnCount = 0;
    std::vector<WorkValue> m_converted; // a row of QVariants made ready to bind
    std::vector<QByteArray> m_encoded;  // the UTF-16 texts of the rows being written, in UTF-8
    QString m_prepareError;
};

} // namespace zorbin
