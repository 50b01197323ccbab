#include "output/CatalogPages.h"

#include "model/ProgressMeter.h"
#include "model/RunContext.h"
#include "output/CatalogRows.h"
#include "output/FileNaming.h"
#include "output/ImageDimensions.h"
#include "output/ItemCell.h"
#include "output/PageLayout.h"
#include "output/PageTemplate.h"
#include "platform/Windows1255Writer.h"

namespace zorbin {
namespace {

// One run of the page writer: walks the catalog rows once, filling the grid of each page row
// by row, and keeps every file it leaves behind a whole document, also when it stops early.
class PagesRun
{
public:
    PagesRun(RunContext &context, const PageLayout &layout, CatalogRows &rows, const QString &pagePrefix,
             const QString &imagesFolder)
        : m_context(context), m_layout(layout), m_rows(rows), m_prefix(pagePrefix), m_sizes(context.files),
          m_cell(layout, rows, imagesFolder, m_sizes, Separators::ofSystem()),
          m_meter(context.user, context.state)
    {
        const long long cellsPerPage = layout.grid.cellsPerPage();
        m_pageCount = (rows.count() + cellsPerPage - 1) / cellsPerPage;
        m_cellCount = m_pageCount * cellsPerPage;
    }

    // The first page's file name (also after a stop), or the failure.
    Result<QString> run()
    {
        if (m_rows.count() == 0)
            return QString();
        const Result<Stop> written = writePages();
        if (!written) {
            (void)abandon(); // the first failure is the one to report
            return written.status();
        }
        // After a stop the bar stays where the writing stopped.
        if (written.value() == Stop::No)
            m_meter.reset();
        return m_firstPage;
    }

private:
    enum class Stop { No, Requested };

    Result<Stop> writePages()
    {
        m_hasItem = m_rows.next();
        if (!m_rows.status())
            return m_rows.status();
        for (long long page = 1; page <= m_pageCount; ++page) {
            if (page == 1 || m_layout.filePerPage) {
                if (const Status opened = openPage(page); !opened)
                    return opened;
            }
            writeOuterTableStart(*m_file);
            m_tableOpen = true;
            if (m_layout.topPercent > 0)
                writeTopBand(*m_file, m_layout);
            auto stop = writeGrid();
            if (!stop)
                return stop.status();
            if (stop.value() == Stop::Requested) {
                if (const Status closed = abandon(); !closed)
                    return closed;
                return Stop::Requested;
            }
            if (m_layout.bottomPercent > 0)
                writeBottomBand(*m_file, m_layout, m_prefix, page, m_pageCount);
            writeOuterTableEnd(*m_file);
            m_tableOpen = false;
            if (page == m_pageCount || m_layout.filePerPage) {
                if (const Status closed = closePage(); !closed)
                    return closed;
            } else if (!m_file->isOk()) {
                const Status failed = m_file->close();
                m_file.reset();
                return failed;
            }
        }
        return Stop::No;
    }

    Status openPage(long long page)
    {
        const QString name = HTMLFileName(m_prefix, page);
        if (page == 1)
            m_firstPage = name;
        auto created = Windows1255Writer::create(m_context.files, name);
        if (!created)
            return created.status();
        m_file = std::move(created).value();
        writeDocumentHead(*m_file);
        return Status::ok();
    }

    Status closePage()
    {
        writeDocumentEnd(*m_file);
        const Status closed = m_file->close();
        m_file.reset();
        return closed;
    }

    Result<Stop> writeGrid()
    {
        for (int row = 1; row <= m_layout.grid.rows; ++row) {
            m_file->writeLine(u"  <tr>");
            m_rowOpen = true;
            for (int column = 1; column <= m_layout.grid.columns; ++column) {
                m_file->writeLine(u"    <td class=D1>");
                m_file->writeLine(u"     <table>");
                m_cellOpen = true;
                if (m_hasItem) {
                    if (const Status written = m_cell.write(*m_file); !written)
                        return written;
                    m_hasItem = m_rows.next();
                    if (!m_rows.status())
                        return m_rows.status();
                } else {
                    writeEmptyCellLines(*m_file);
                }
                writeCellEnd();
                ++m_cellsDone;
                if (m_meter.tick(m_cellsDone, m_cellCount))
                    return Stop::Requested;
            }
            m_file->writeLine(u"  </tr>");
            m_rowOpen = false;
        }
        return Stop::No;
    }

    void writeCellEnd()
    {
        m_file->writeLine(u"     </table>");
        m_file->writeLine(u"    </td>");
        m_cellOpen = false;
    }

    // Ends the open page where it stands: closes its grid cell and row, its outer table and
    // the document, so that the file is a whole page.
    Status abandon()
    {
        if (!m_file)
            return Status::ok();
        if (m_cellOpen)
            writeCellEnd();
        if (m_rowOpen)
            m_file->writeLine(u"  </tr>");
        if (m_tableOpen)
            writeOuterTableEnd(*m_file);
        writeDocumentEnd(*m_file);
        const Status closed = m_file->close();
        m_file.reset();
        m_rowOpen = m_tableOpen = false;
        return closed;
    }

    RunContext &m_context;
    const PageLayout &m_layout;
    CatalogRows &m_rows;
    QString m_prefix;
    ImageSizes m_sizes;
    ItemCell m_cell;
    ProgressMeter m_meter;
    long long m_pageCount = 0;
    long long m_cellCount = 0;
    long long m_cellsDone = 0;
    bool m_hasItem = false;
    std::unique_ptr<Windows1255Writer> m_file;
    bool m_cellOpen = false; // a cell's own table holds the item's lines
    bool m_rowOpen = false;
    bool m_tableOpen = false;
    QString m_firstPage;
};

} // namespace

Result<QString> CreateCatHTML(RunContext &context, const QString &pagePrefix, const QString &dbFile,
                              const QString &imagesFolder)
{
    ProgressMeter(context.user, context.state).reset();
    const auto layout = PageLayout::read(context.settings, imagesFolder);
    if (!layout)
        return layout.status();
    auto rows = CatalogRows::open(dbFile, context.settings);
    if (!rows)
        return rows.status();
    PagesRun run(context, layout.value(), *rows.value(), pagePrefix, imagesFolder);
    return run.run();
}

} // namespace zorbin
