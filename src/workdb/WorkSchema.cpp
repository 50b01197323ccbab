#include "workdb/WorkSchema.h"

#include "workdb/HebrewCollation.h"

namespace zorbin {
namespace {

WorkColumn text(const char *name, int size)
{
    return {QLatin1String(name), WorkColumn::Text, size};
}

WorkColumn column(const char *name, WorkColumn::Type type)
{
    return {QLatin1String(name), type, 0};
}

WorkTable priceTable(const char *name)
{
    return {QLatin1String(name), {text("ItemKey", 20), text("Coin", 5), column("Price", WorkColumn::Double)}};
}

WorkTable noteTable(const char *name)
{
    return {QLatin1String(name), {text("ItemKey", 20), text("ExtraNote", 250)}};
}

QString columnDefinition(const WorkColumn &column, bool isKey)
{
    QString definition = column.name;
    switch (column.type) {
    case WorkColumn::Text:
        definition += QStringLiteral(" TEXT COLLATE %1").arg(QLatin1String(HebrewCollationName));
        break;
    case WorkColumn::Long:
        definition += QStringLiteral(" INT"); // not INTEGER: that would make the key an alias of the row id
        break;
    case WorkColumn::Double:
        definition += QStringLiteral(" REAL");
        break;
    case WorkColumn::Boolean:
        definition += QStringLiteral(" INT NOT NULL DEFAULT %1").arg(WorkFalse);
        break;
    }
    if (isKey)
        definition += QStringLiteral(" PRIMARY KEY");
    if (column.type == WorkColumn::Text)
        definition +=
            QStringLiteral(" CONSTRAINT %1 CHECK (length(%1) <= %2)").arg(column.name).arg(column.size);
    if (column.type == WorkColumn::Boolean)
        definition += QStringLiteral(" CONSTRAINT %1 CHECK (%1 IN (%2, %3))")
                          .arg(column.name)
                          .arg(WorkTrue)
                          .arg(WorkFalse);
    return definition;
}

} // namespace

QStringList WorkTable::columnNames() const
{
    QStringList names;
    for (const WorkColumn &column : columns)
        names << column.name;
    return names;
}

const std::vector<WorkTable> &workTables()
{
    static const std::vector<WorkTable> tables = {
        {QStringLiteral("tItems"),
         {text("ItemKey", 20), text("ItemName", 100), column("ItemSort", WorkColumn::Long),
          text("Filter", 10), text("Unit", 5), column("SellPrice", WorkColumn::Double), text("SellCoin", 5),
          text("ItemPic", 250), column("Include", WorkColumn::Boolean)}},
        priceTable("tItemPrice1"),
        priceTable("tItemPrice2"),
        noteTable("tExtraNote1"),
        noteTable("tExtraNote2"),
        {QStringLiteral("tItemSort"), {column("ItemSort", WorkColumn::Long), text("SortName", 50)}},
    };
    return tables;
}

const WorkTable *findWorkTable(const QString &name)
{
    for (const WorkTable &table : workTables()) {
        if (table.name == name)
            return &table;
    }
    return nullptr;
}

std::optional<int> workTextSize(const QString &columnName)
{
    for (const WorkTable &table : workTables()) {
        for (const WorkColumn &column : table.columns) {
            if (column.type == WorkColumn::Text && column.name == columnName)
                return column.size;
        }
    }
    return std::nullopt;
}

QString createTableStatement(const WorkTable &table)
{
    QStringList definitions;
    for (std::size_t i = 0; i < table.columns.size(); ++i)
        definitions << columnDefinition(table.columns[i], i == 0);
    return QStringLiteral("CREATE TABLE %1 (%2) STRICT")
        .arg(table.name, definitions.join(QStringLiteral(", ")));
}

} // namespace zorbin
