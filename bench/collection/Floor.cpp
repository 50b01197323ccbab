#include "Floor.h"

#include "platform/FileSystem.h"
#include "workdb/SourceStatements.h"
#include "workdb/WorkDatabase.h"

#include <QElapsedTimer>
#include <QSqlQuery>

namespace zorbin::bench {
namespace {

struct Copy
{
    QString table;
    QString columns;
    QString select; // over the statement's rows, named as the statement names them
    QString statement;
};

double secondsSince(const QElapsedTimer &clock)
{
    return static_cast<double>(clock.nsecsElapsed()) / 1e9;
}

} // namespace

Result<std::vector<TableTiming>> measureFloor(const CatalogSettings &settings, const QString &sourcePath,
                                              const QString &workPath)
{
    std::vector<TableTiming> timings;
    QElapsedTimer clock;
    clock.start();
    if (Status created = createWorkDatabase(localFileSystem(), workPath); !created)
        return created;
    Result<std::unique_ptr<WorkDatabase>> opened = WorkDatabase::open(workPath);
    if (!opened)
        return opened.status();
    WorkDatabase &work = *opened.value();
    timings.push_back({QStringLiteral("create"), 0, secondsSince(clock)});

    QString attachedPath = sourcePath;
    attachedPath.replace(QLatin1Char('\''), QStringLiteral("''"));
    if (WriteOutcome attached = work.exec(QStringLiteral("ATTACH DATABASE '%1' AS source").arg(attachedPath));
        !attached)
        return attached.status();

    const QString items =
        QStringLiteral("ItemKey, ItemName, ItemSort, Filter, Unit, ItemPic, Include, SellPrice, SellCoin");
    const std::vector<Copy> copies = {
        {QStringLiteral("tItems"), items,
         QStringLiteral("ItemKey, coalesce(ItemDesc, '?'), SortGroup, Filter, coalesce(SalesUnit, '?'), "
                        "coalesce(PicFile, '?'), -1, Price, coalesce(Currency, '?')"),
         buildItemStatement(settings).value()},
        {QStringLiteral("tItemSort"), QStringLiteral("ItemSort, SortName"),
         QStringLiteral("ItemSortCode, nullif(SortCodeName, '')"), buildSortGroupStatement()},
        {QStringLiteral("tItemPrice1"), QStringLiteral("ItemKey, Coin, Price"),
         QStringLiteral("ItemKey, coalesce(CurrencyCode, 'ש\"ח'), Price"),
         buildPriceStatement(settings, 1).value()},
        {QStringLiteral("tItemPrice2"), QStringLiteral("ItemKey, Coin, Price"),
         QStringLiteral("ItemKey, coalesce(CurrencyCode, 'ש\"ח'), Price"),
         buildPriceStatement(settings, 2).value()},
        {QStringLiteral("tExtraNote1"), QStringLiteral("ItemKey, ExtraNote"),
         QStringLiteral("ItemKey, coalesce(Note, '?')"), buildExtraNoteStatement(settings, 1).value()},
        {QStringLiteral("tExtraNote2"), QStringLiteral("ItemKey, ExtraNote"),
         QStringLiteral("ItemKey, coalesce(Note, '?')"), buildExtraNoteStatement(settings, 2).value()},
    };
    for (const Copy &copy : copies) {
        clock.restart();
        QString sql = QStringLiteral("INSERT OR IGNORE INTO %1 (%2) SELECT %3 FROM (%4)")
                          .arg(copy.table, copy.columns, copy.select, copy.statement);
        if (copy.table != QLatin1String("tItemSort"))
            sql += QStringLiteral(" WHERE ItemKey <> ''"); // the steps pass over an empty key
        if (WriteOutcome inserted = work.exec(sql); !inserted)
            return inserted.status();
        const double seconds = secondsSince(clock);
        Result<QSqlQuery> counted = work.select(QStringLiteral("SELECT count(*) FROM ") + copy.table);
        long long rows = 0;
        if (counted && counted->next())
            rows = counted->value(0).toLongLong();
        timings.push_back({copy.table, rows, seconds});
    }
    return timings;
}

} // namespace zorbin::bench
