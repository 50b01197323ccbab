#pragma once

#include <QString>
#include <QStringList>
#include <optional>
#include <vector>

namespace zorbin {

// The six tables of the working database: names, columns, types and sizes, in the order in
// which they are created. Text columns hold at most `size` characters and compare under the
// Hebrew collation; Booleans hold -1 for true and 0 for false, never Null.
struct WorkColumn
{
    enum Type { Text, Long, Double, Boolean };

    QString name;
    Type type;
    int size = 0; // characters, for Text; 0 otherwise
};

struct WorkTable
{
    QString name;
    std::vector<WorkColumn> columns; // the first is the primary key

    const WorkColumn &key() const { return columns.front(); }
    QStringList columnNames() const;
};

// How the working database stores the Boolean values.
inline constexpr int WorkTrue = -1;
inline constexpr int WorkFalse = 0;

// The tables in creation order: tItems, tItemPrice1, tItemPrice2, tExtraNote1, tExtraNote2, tItemSort.
const std::vector<WorkTable> &workTables();
// The table of that name (exact spelling), or nothing.
const WorkTable *findWorkTable(const QString &name);
// The size in characters of a text column of that name (the names are unique across the
// tables, and so are their sizes), or nothing for another column.
std::optional<int> workTextSize(const QString &columnName);

// The CREATE TABLE statement of a table: STRICT, so that a value of the wrong kind is refused;
// one primary key and no other index; a CHECK named after each text column that limits its
// length, and one named Include that keeps the Booleans to -1 and 0.
QString createTableStatement(const WorkTable &table);

} // namespace zorbin
