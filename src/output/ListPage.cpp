#include "output/ListPage.h"

#include "model/ProgressMeter.h"
#include "model/RunContext.h"
#include "output/CatalogRows.h"
#include "output/FileNaming.h"
#include "platform/ValueFormat.h"
#include "platform/Windows1255Writer.h"

namespace zorbin {
namespace {

void writeListHead(Windows1255Writer &list, const QDate &today)
{
    list.writeLine(u"<HTML>");
    list.writeLine(u"<HEAD>");
    list.writeLine(u"<TITLE>טרניק מערכות מידע מציגה</TITLE>");
    list.writeLine(u"<meta http-equiv='Content-Type' content='text/html; charset=windows-1255'>");
    list.writeLine(u"<style>.MyClass1{font-size : 10pt; color: blue;}");
    list.writeLine(u"       .Title1 {font-size : 12pt; color: blue; font-weight : bold;}");
    list.writeLine(u"       TD {font-size : 9pt; color: black;}");
    list.writeLine(u"</style>");
    list.writeLine(u"</HEAD>");
    list.writeLine(u"<BODY class=MyClass1 BGCOLOR='#FFFFFF' TEXT='#000000' LINK='#0000FF' VLINK='#800080'>");
    list.writeLine(QStringLiteral("<p class=Title1 align='left'>") +
                   formatDate(today, Separators::ofSystem()) + QStringLiteral("</p>"));
    list.writeLine(u"<p class=Title1 align='right'>זורבין לויזקאונט לחלונות</p>");
    list.writeLine(u"<table width='100%' border='0' cellpadding='1' cellspacing='1'>");
    list.writeLine(u"  <tr><td colspan='2'><hr noshade size='2'></td></tr>");
    list.writeLine(u"  <tr bgcolor='white' align='right'>");
    list.writeLine(u"    <td>שם פריט</td>");
    list.writeLine(u"    <td>מפתח פריט</td>");
    list.writeLine(u"  </tr>");
    list.writeLine(u"  <tr><td colspan='2'><hr noshade size='2'></td></tr>");
}

void writeListFooter(Windows1255Writer &list)
{
    list.writeLine(u"<hr noshade width='100%' size='2'>");
    list.writeLine(u"<p class=Title1 align='center'>טרניק מערכות מידע</p>");
}

void writeListEnd(Windows1255Writer &list)
{
    list.writeLine(u"</BODY>");
    list.writeLine(u"</HTML>");
}

// The item rows. Returns whether the user asked to stop.
Result<bool> writeItemRows(Windows1255Writer &list, CatalogRows &rows, ProgressMeter &meter)
{
    const int name = rows.column(QStringLiteral("ItemName"));
    const int key = rows.column(QStringLiteral("ItemKey"));
    long long done = 0;
    while (rows.next()) {
        list.writeLine(u"  <tr bgcolor='#FFFFFF' align='right'>");
        list.write(u"    <td>");
        if (const QVariant value = rows.value(name); value.isNull())
            list.write(u"&nbsp;");
        else
            list.writeEscaped(value.toString());
        list.writeLine(u"</td>");
        list.write(u"    <td>");
        list.writeEscaped(rows.value(key).toString());
        list.writeLine(u"</td>");
        list.writeLine(u"  </tr>");
        if (meter.point(++done, rows.count()))
            return true;
    }
    if (!rows.status())
        return rows.status();
    return false;
}

} // namespace

Status writeListPage(RunContext &context, const QString &fileName, const QString &dbFile, const QDate &today)
{
    ProgressMeter meter(context.user, context.state);
    meter.reset();
    // The statement is opened before the file is replaced, so that a working database that
    // cannot be read leaves no half-written list behind.
    auto rows = CatalogRows::open(dbFile, context.settings);
    if (!rows)
        return rows.status();
    auto created = Windows1255Writer::create(context.files, fileName);
    if (!created)
        return created.status();
    Windows1255Writer &list = *created.value();
    writeListHead(list, today);
    const auto stopped = writeItemRows(list, *rows.value(), meter);
    // Whichever way the rows end, the list is closed as a whole page; the footer follows the
    // rows only when the list was written to its end.
    list.writeLine(u"</table>");
    if (stopped && !stopped.value() && rows.value()->count() > 0)
        writeListFooter(list);
    writeListEnd(list);
    const Status closed = list.close();
    if (!stopped)
        return stopped.status();
    if (closed)
        meter.reset();
    return closed;
}

Status CreateListHTML(RunContext &context, const QString &fileName, const QString &dbFile)
{
    return writeListPage(context, fileName, dbFile, QDate::currentDate());
}

} // namespace zorbin
