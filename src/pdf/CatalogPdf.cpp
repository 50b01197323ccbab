#include "pdf/CatalogPdf.h"

#include "model/CatalogField.h"
#include "model/ProgressMeter.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "output/CatalogRows.h"
#include "output/PictureReference.h"
#include "pdf/PdfCell.h"
#include "pdf/PdfLayout.h"
#include "pdf/PdfPage.h"
#include "pdf/PdfPictures.h"
#include "pdf/PdfText.h"
#include "platform/FileSystem.h"

#include <QDir>
#include <QGuiApplication>
#include <QPainter>
#include <QPdfWriter>
#include <QSaveFile>
#include <algorithm>
#include <optional>

#ifdef __GLIBC__
#include <malloc.h>
#endif

namespace zorbin {
namespace {

constexpr int Resolution = 1200; // device units an inch: positions to 1/1200 inch
constexpr double UnitsPerPoint = Resolution / 72.0;
constexpr double MarginMillimetres = 10;
constexpr double BandPaddingPoints = 2;

// The stylesheet's band classes: Top1 12 pt, Top2 and Bot1 11 pt, plain cells 9 pt, all Arial.
PdfTextFormat bandFormat(double points, PdfAlign align)
{
    PdfTextFormat format;
    format.points = points;
    format.align = align;
    return format;
}

// Qt's PDF engine compresses each finished page through two buffers of 10 MB. With glibc's
// default thresholds these are mapped from and given back to the kernel on every page, which
// cost more than drawing a page. These thresholds, the highest glibc itself moves them to on
// its own (32 MB, trimming above 64 MB), keep such buffers in the heap for reuse.
void keepLargeBuffersInHeap()
{
#ifdef __GLIBC__
    static const bool done = [] {
        mallopt(M_MMAP_THRESHOLD, 32 * 1024 * 1024);
        mallopt(M_TRIM_THRESHOLD, 64 * 1024 * 1024);
        return true;
    }();
    (void)done;
#endif
}

QString joinedLines(const QString &typed)
{
    return plainLinesOfMarkup(typed).join(QChar::LineSeparator);
}

// The top band (two titles at the right, the logo at the left) and the bottom band (its title
// in the middle, "עמוד X מתוך Y" at the left), worked out once and drawn on every page.
class Bands
{
public:
    Bands(const PdfLayout &layout, const PdfPageGeometry &page, QPaintDevice &device, const FileSystem &files)
        : m_page(page), m_device(device), m_numberFont(pdfFont(bandFormat(9, PdfAlign::Left)))
    {
        const double padding = BandPaddingPoints * UnitsPerPoint;
        if (!page.topBand.isEmpty()) {
            const double half = page.topBand.width() / 2 - padding;
            m_title = PdfText(joinedLines(layout.topTitle), pdfFont(bandFormat(12, PdfAlign::Right)), &device,
                              Qt::RightToLeft, PdfAlign::Right, half);
            m_title2 = PdfText(joinedLines(layout.topTitle2), pdfFont(bandFormat(11, PdfAlign::Right)),
                               &device, Qt::RightToLeft, PdfAlign::Right, half);
            const QSizeF logoBox(half, page.topBand.height() - 2 * padding);
            if (const std::optional<QString> logo = logoSourceFile(files, layout.logo);
                logo && !logoBox.isEmpty()) {
                m_logoPictures.emplace(files, logoBox / UnitsPerPoint);
                m_logo = m_logoPictures->picture(*logo);
                if (m_logo)
                    m_logoSize = fittedSize(m_logo->natural * UnitsPerPoint, logoBox);
            }
        }
        if (!page.bottomBand.isEmpty())
            m_bottomTitle =
                PdfText(joinedLines(layout.bottomTitle), pdfFont(bandFormat(11, PdfAlign::Centre)), &device,
                        Qt::RightToLeft, PdfAlign::Centre, page.bottomBand.width() * 0.6);
    }

    void draw(QPainter &painter, long long pageNumber, long long pageCount)
    {
        const double padding = BandPaddingPoints * UnitsPerPoint;
        if (const QRectF band = m_page.topBand; !band.isEmpty()) {
            const double titles = m_title.height() + m_title2.height();
            const bool overflows = titles > band.height();
            if (overflows) {
                painter.save();
                painter.setClipRect(band);
            }
            const double left = band.center().x();
            const double top = band.top() + std::max(0.0, (band.height() - titles) / 2);
            m_title.draw(painter, QPointF(left, top));
            m_title2.draw(painter, QPointF(left, top + m_title.height()));
            if (overflows)
                painter.restore();
            if (m_logo && !m_logoSize.isEmpty())
                painter.drawImage(QRectF(QPointF(band.left() + padding,
                                                 band.top() + (band.height() - m_logoSize.height()) / 2),
                                         m_logoSize),
                                  m_logo->image);
        }
        if (const QRectF band = m_page.bottomBand; !band.isEmpty()) {
            const PdfText number(QStringLiteral("עמוד %1 מתוך %2").arg(pageNumber).arg(pageCount),
                                 m_numberFont, &m_device, Qt::RightToLeft, PdfAlign::Left,
                                 band.width() * 0.2 - padding);
            const double tallest = std::max(m_bottomTitle.height(), number.height());
            const bool overflows = tallest > band.height();
            if (overflows) {
                painter.save();
                painter.setClipRect(band);
            }
            m_bottomTitle.draw(painter, QPointF(band.left() + band.width() * 0.2,
                                                band.top() + (band.height() - m_bottomTitle.height()) / 2));
            number.draw(painter,
                        QPointF(band.left() + padding, band.top() + (band.height() - number.height()) / 2));
            if (overflows)
                painter.restore();
        }
    }

private:
    const PdfPageGeometry &m_page;
    QPaintDevice &m_device;
    QFont m_numberFont;
    PdfText m_title;
    PdfText m_title2;
    PdfText m_bottomTitle;
    std::optional<PdfPictures> m_logoPictures;
    const PdfPicture *m_logo = nullptr;
    QSizeF m_logoSize;
};

// One PDF run: walks the catalog rows once, filling the grid of each page row by row, each row
// from the right.
class PdfRun
{
public:
    PdfRun(RunContext &context, const PdfRequest &request, const PdfLayout &layout, CatalogRows &rows,
           QHash<QString, int> pictureUses)
        : m_context(context), m_request(request), m_layout(layout), m_rows(rows),
          m_pictureUses(std::move(pictureUses)), m_meter(context.user, context.state)
    {
        const long long cellsPerPage = layout.cellsPerPage();
        m_pageCount = (rows.count() + cellsPerPage - 1) / cellsPerPage;
        m_cellCount = m_pageCount * cellsPerPage;
    }

    Result<PdfWritten> run()
    {
        QSaveFile file(m_request.file);
        file.setDirectWriteFallback(false);
        if (!file.open(QIODevice::WriteOnly))
            return Status::fault(QStringLiteral("לא ניתן לכתוב את הקובץ %1: %2")
                                     .arg(QDir::toNativeSeparators(m_request.file), file.errorString()));
        Result<bool> drawn = false;
        {
            QPdfWriter writer(&file);
            writer.setPageLayout(QPageLayout(
                QPageSize(m_request.pageSize == PdfPageSize::Letter ? QPageSize::Letter : QPageSize::A4),
                QPageLayout::Portrait,
                QMarginsF(MarginMillimetres, MarginMillimetres, MarginMillimetres, MarginMillimetres),
                QPageLayout::Millimeter));
            writer.setResolution(Resolution);
            writer.setCreator(QStringLiteral("Zorbin"));
            writer.setTitle(plainLinesOfMarkup(m_layout.topTitle).join(QLatin1Char(' ')));
            QPainter painter;
            if (!painter.begin(&writer))
                return Status::fault(QStringLiteral("לא ניתן ליצור את קובץ ה-PDF %1.")
                                         .arg(QDir::toNativeSeparators(m_request.file)));
            drawn = drawPages(painter, writer);
            painter.end();
        }
        if (!drawn || !drawn.value()) {
            file.cancelWriting(); // the temporary file goes; an older file stays as it was
            if (!drawn)
                return drawn.status();
            return PdfWritten{PdfWritten::Ending::Stopped, {}, 0, m_picturesDecoded, m_picturesHeld};
        }
        if (!file.commit())
            return Status::fault(QStringLiteral("לא ניתן לכתוב את הקובץ %1: %2")
                                     .arg(QDir::toNativeSeparators(m_request.file), file.errorString()));
        m_meter.reset();
        return PdfWritten{PdfWritten::Ending::Written, m_request.file, m_pageCount, m_picturesDecoded,
                          m_picturesHeld};
    }

private:
    // True when every page was drawn, false after a stop.
    Result<bool> drawPages(QPainter &painter, QPdfWriter &writer)
    {
        const PdfPageGeometry page =
            pageGeometry(QSizeF(writer.width(), writer.height()), m_layout.topPercent, m_layout.bottomPercent,
                         m_layout.rows, m_layout.columns);
        Bands bands(m_layout, page, writer, m_context.files);
        PdfCell cell(m_layout, m_rows, writer, m_context.files, page.cellSize(), UnitsPerPoint,
                     Separators::ofSystem(), std::move(m_pictureUses));
        QPen frame(Qt::black);
        frame.setWidthF(0.5 * UnitsPerPoint);
        painter.setPen(Qt::black);

        bool hasItem = m_rows.next();
        if (!m_rows.status())
            return m_rows.status();
        long long cellsDone = 0;
        for (long long pageNumber = 1; pageNumber <= m_pageCount; ++pageNumber) {
            if (pageNumber > 1 && !writer.newPage())
                return Status::fault(QStringLiteral("לא ניתן לכתוב את הקובץ %1.")
                                         .arg(QDir::toNativeSeparators(m_request.file)));
            bands.draw(painter, pageNumber, m_pageCount);
            if (m_layout.frames)
                drawFrames(painter, page, frame);
            for (int row = 0; row < page.rows; ++row) {
                for (int column = 0; column < page.columns; ++column) {
                    if (hasItem) {
                        if (const Status drawnCell = cell.draw(painter, page.cell(row, column)); !drawnCell)
                            return drawnCell;
                        hasItem = m_rows.next();
                        if (!m_rows.status())
                            return m_rows.status();
                    }
                    ++cellsDone;
                    if (m_meter.tick(cellsDone, m_cellCount)) {
                        m_picturesDecoded = cell.picturesDecoded();
                        m_picturesHeld = cell.picturesHeldAtMost();
                        return false;
                    }
                }
            }
        }
        m_picturesDecoded = cell.picturesDecoded();
        m_picturesHeld = cell.picturesHeldAtMost();
        return true;
    }

    // A thin frame around every cell, the empty ones after the last item too, as the pages
    // draw one around every cell of the grid.
    static void drawFrames(QPainter &painter, const PdfPageGeometry &page, const QPen &pen)
    {
        painter.save();
        painter.setPen(pen);
        painter.setBrush(Qt::NoBrush);
        const QSizeF size = page.cellSize();
        for (int row = 0; row <= page.rows; ++row) {
            const double y = page.grid.top() + row * size.height();
            painter.drawLine(QPointF(page.grid.left(), y), QPointF(page.grid.right(), y));
        }
        for (int column = 0; column <= page.columns; ++column) {
            const double x = page.grid.left() + column * size.width();
            painter.drawLine(QPointF(x, page.grid.top()), QPointF(x, page.grid.bottom()));
        }
        painter.restore();
    }

    RunContext &m_context;
    const PdfRequest &m_request;
    const PdfLayout &m_layout;
    CatalogRows &m_rows;
    QHash<QString, int> m_pictureUses;
    ProgressMeter m_meter;
    long long m_pageCount = 0;
    long long m_cellCount = 0;
    int m_picturesDecoded = 0;
    int m_picturesHeld = 0;
};

// How many items show each picture reference: a first pass over the rows, so that each picture
// can be let go after its last item and memory does not grow with the number of pictures.
// Empty when no line shows the picture.
Result<QHash<QString, int>> pictureUses(RunContext &context, const PdfRequest &request,
                                        const PdfLayout &layout)
{
    QHash<QString, int> uses;
    const auto line = std::find_if(layout.lines.cbegin(), layout.lines.cend(),
                                   [](const PdfLine &used) { return used.field == PictureField; });
    if (line == layout.lines.cend())
        return uses;
    Result<std::unique_ptr<CatalogRows>> rows = openPdfRows(request.dbFile, context.settings);
    if (!rows)
        return rows.status();
    const int column = rows.value()->column(line->column);
    while (rows.value()->next()) {
        const QVariant value = rows.value()->value(column);
        ++uses[value.isNull() ? QString() : value.toString()];
    }
    if (!rows.value()->status())
        return rows.value()->status();
    return uses;
}

} // namespace

Result<PdfWritten> CreateCatPDF(RunContext &context, const PdfRequest &request)
{
    ProgressMeter(context.user, context.state).reset();
    if (!qobject_cast<QGuiApplication *>(QCoreApplication::instance()))
        return Status::fault(QStringLiteral("The PDF writer needs a QGuiApplication (fonts and pictures)."));
    const Result<PdfLayout> layout = readPdfLayout(context.settings);
    if (!layout)
        return layout.status();
    Result<std::unique_ptr<CatalogRows>> rows = openPdfRows(request.dbFile, context.settings);
    if (!rows)
        return rows.status();
    if (rows.value()->count() == 0)
        return PdfWritten{PdfWritten::Ending::NoItems, {}, 0, 0, 0};
    Result<QHash<QString, int>> uses = pictureUses(context, request, layout.value());
    if (!uses)
        return uses.status();
    keepLargeBuffersInHeap();
    PdfRun run(context, request, layout.value(), *rows.value(), std::move(uses).value());
    return run.run();
}

} // namespace zorbin
