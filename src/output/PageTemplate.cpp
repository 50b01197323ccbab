#include "output/PageTemplate.h"

#include "output/FileNaming.h"
#include "output/OutputFolder.h"
#include "output/PageLayout.h"
#include "platform/Windows1255Writer.h"

namespace zorbin {

void writeDocumentHead(Windows1255Writer &page)
{
    page.writeLine(u"<HTML>");
    page.writeLine(u"<HEAD>");
    page.writeLine(u"<TITLE>טרניק מערכות מידע מציגה</TITLE>");
    page.writeLine(u"<meta http-equiv='Content-Type' content='text/html; charset=windows-1255'>");
    page.writeLine(QStringLiteral("<link rel='stylesheet' type='text/css' href='") + StylesheetName +
                   QStringLiteral("' rev='stylesheet'>"));
    page.writeLine(u"</HEAD>");
    page.writeLine(u"<BODY BGCOLOR='#FFFFFF'>");
}

void writeOuterTableStart(Windows1255Writer &page)
{
    page.writeLine(u"<table height='100%' width='100%'>");
}

void writeTopBand(Windows1255Writer &page, const PageLayout &layout)
{
    page.writeLine(QStringLiteral("  <tr><td colspan=") + QString::number(layout.grid.columns) +
                   QStringLiteral(" height='") + QString::number(layout.topPercent) + QStringLiteral("%'>"));
    page.writeLine(u"   <table width='100%'>");
    page.writeLine(u"    <tr>");
    page.writeLine(QStringLiteral("     <td class=Top1 width='50%' align=right>") + layout.topTitle +
                   QStringLiteral("</td>"));
    page.write(u"     <td rowspan=2 width='50%' align=left>");
    if (!layout.logoReference.isEmpty())
        page.write(QStringLiteral("<img src='") + attributeFileReference(layout.logoReference) +
                   QStringLiteral("' border=0>"));
    page.writeLine(u"</td>");
    page.writeLine(u"    </tr>");
    page.writeLine(u"    <tr>");
    page.writeLine(QStringLiteral("     <td class=Top2 width='50%' align=right>") + layout.topTitle2 +
                   QStringLiteral("</td>"));
    page.writeLine(u"    </tr>");
    page.writeLine(u"   </table>");
    page.writeLine(u"  </td></tr>");
}

void writeBottomBand(Windows1255Writer &page, const PageLayout &layout, const QString &pagePrefix,
                     long long pageNumber, long long pageCount)
{
    page.writeLine(QStringLiteral("  <tr><td colspan=") + QString::number(layout.grid.columns) +
                   QStringLiteral(" height='") + QString::number(layout.bottomPercent) +
                   QStringLiteral("%'>"));
    page.writeLine(u"   <table width='100%'>");
    page.writeLine(u"    <tr>");
    page.writeLine(u"     <td width='10%' align=right>");
    if (layout.filePerPage && pageNumber > 1)
        page.writeLine(QStringLiteral("     <a href='") +
                       attributeFileReference(HTMLFileName(pagePrefix, pageNumber - 1)) +
                       QStringLiteral("' rel=next target='_self'>לעמוד הקודם</a>"));
    page.writeLine(u"     </td>");
    page.writeLine(QStringLiteral("     <td width='80%' class=Bot1 align=center>") + layout.bottomTitle +
                   QStringLiteral("</td>"));
    page.writeLine(u"     <td width='10%' align=left>");
    if (layout.filePerPage && pageNumber < pageCount)
        page.writeLine(QStringLiteral("     <a href='") +
                       attributeFileReference(HTMLFileName(pagePrefix, pageNumber + 1)) +
                       QStringLiteral("' rel=next target='_self'>לעמוד הבא</a>"));
    page.writeLine(u"     </td>");
    page.writeLine(u"    </tr>");
    page.writeLine(u"   </table>");
    page.writeLine(u"  </td></tr>");
}

void writeEmptyCellLines(Windows1255Writer &page)
{
    page.writeLine(u"    <tr><td colspan=2>&nbsp;</td></tr>");
}

void writeOuterTableEnd(Windows1255Writer &page)
{
    page.writeLine(u"</table>");
}

void writeDocumentEnd(Windows1255Writer &page)
{
    page.writeLine(u"</BODY>");
    page.writeLine(u"</HTML>");
}

} // namespace zorbin
