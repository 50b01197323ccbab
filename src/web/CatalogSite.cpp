#include "web/CatalogSite.h"

#include "model/ProgressMeter.h"
#include "model/RunContext.h"
#include "output/CatalogRows.h"
#include "output/OutputFolder.h"
#include "platform/FileSystem.h"
#include "platform/Paths.h"
#include "web/ItemArticle.h"
#include "web/ItemSpool.h"
#include "web/SearchIndex.h"
#include "web/SiteFile.h"
#include "web/SiteLayout.h"
#include "web/SiteNames.h"
#include "web/SitePage.h"
#include "web/SiteScript.h"
#include "web/SiteSections.h"
#include "web/SiteStaging.h"
#include "web/SiteStyle.h"
#include "web/ThumbnailStore.h"

#include <cstring>
#include <map>

namespace zorbin {
namespace {

// The logo's box: a band's height, most of a phone's width.
const QSize LogoBox(480, 160);

// Where the first pass keeps the items it made, in the staging folder.
const QString SpoolName = QStringLiteral("items.spool");

// An item as the spool holds it: the length of its article's inside, that inside, and the start
// of its search entry.
using ArticleLength = qint32;

// One run of the site writer. The first pass reads the catalog rows once, in catalog order,
// makes the thumbnails and writes each item's article into the spool, in the stream of its
// section (one stream without sections), keeping only the item's sort group in memory; the
// second pass writes the pages in site order, reading each section's stream from start to end.
// So a catalog of any size costs little memory beyond a few bytes an item.
class SiteRun
{
public:
    enum class Stop { No, Requested };

    SiteRun(RunContext &context, const SiteRequest &request, const SiteLayout &layout, CatalogRows &rows,
            ThumbnailStore &pictures, const SiteStaging &staging, QHash<qint64, QString> groupNames)
        : m_context(context), m_request(request), m_layout(layout), m_rows(rows), m_pictures(pictures),
          m_staging(staging), m_groupNames(std::move(groupNames)),
          m_article(layout, rows, Separators::ofSystem()), m_meter(context.user, context.state),
          m_total(2 * rows.count())
    {}

    // Writes the site into the staging folder. Nothing is staged for a catalog without items.
    Result<Stop> build()
    {
        if (m_rows.count() == 0)
            return Stop::No;
        auto spool = ItemSpool::create(m_staging.path(SpoolName));
        if (!spool)
            return spool.status();
        m_spool = std::move(spool).value();
        auto spooled = spoolItems();
        if (!spooled || spooled.value() == Stop::Requested || m_count == 0)
            return spooled;
        if (m_request.sections)
            m_sections = planSections(m_groups, m_groupNames);
        m_groups = {};
        if (m_layout.topBand && !m_layout.logo.isEmpty()) {
            if (const auto logo = m_context.files.findFile(m_layout.logo)) {
                auto made = m_pictures.thumbnailOf(*logo, LogoBox);
                if (!made)
                    return made.status();
                m_logo = made.value();
            }
        }
        auto written = writePages();
        m_spool.reset();
        if (!written || written.value() == Stop::Requested)
            return written;
        if (const Status styled = writeFile(site::StylesheetName, siteStylesheet(m_layout)); !styled)
            return styled;
        if (const Status scripted = writeFile(site::ScriptName, siteScript()); !scripted)
            return scripted;
        return Stop::No;
    }

    // The files written into the staging folder, by name.
    const QStringList &staged() const { return m_staged; }

private:
    Result<Stop> spoolItems()
    {
        QByteArray record;
        QByteArray entry;
        while (m_rows.next()) {
            std::optional<Thumbnail> picture;
            if (const QString reference = m_article.pictureReference(); !reference.isEmpty()) {
                auto found = pictureOf(reference);
                if (!found)
                    return found.status();
                picture = found.value();
            }
            record.resize(sizeof(ArticleLength));
            entry.truncate(0);
            if (const Status written = m_article.write(picture ? &*picture : nullptr, record, entry);
                !written)
                return written;
            const auto articleLength = static_cast<ArticleLength>(record.size() - sizeof(ArticleLength));
            std::memcpy(record.data(), &articleLength, sizeof articleLength);
            record += entry;
            std::size_t stream = 0;
            if (m_request.sections) {
                m_groups.push_back(m_article.sortGroup());
                stream = streamOf(m_groups.back());
            }
            if (const Status spooled = m_spool->append(stream, record); !spooled)
                return spooled;
            if (m_meter.tick(++m_count, m_total))
                return Stop::Requested;
        }
        if (!m_rows.status())
            return m_rows.status();
        if (const Status finished = m_spool->finish(); !finished)
            return finished;
        return Stop::No;
    }

    // The spool's stream of a section, numbered as the sections first occur in the catalog.
    std::size_t streamOf(const std::optional<qint64> &group)
    {
        const auto [known, added] = m_streams.try_emplace(group, m_streams.size());
        Q_UNUSED(added);
        return known->second;
    }

    // Each reference is looked up once a run: items share pictures.
    Result<Thumbnail> pictureOf(const QString &reference)
    {
        if (const auto known = m_thumbnails.constFind(reference); known != m_thumbnails.cend())
            return known.value();
        // Looked up as the classic catalog's picture copying looks it up.
        const std::optional<QString> file = m_context.files.findFile(reference);
        auto made = file ? m_pictures.thumbnailOf(*file, m_layout.pictureBox)
                         : m_pictures.placeholder(m_layout.pictureBox);
        if (made)
            m_thumbnails.insert(reference, made.value());
        return made;
    }

    Result<Stop> writePages()
    {
        const long long perPage = m_layout.itemsPerPage();
        const long long pageCount = (m_count + perPage - 1) / perPage;
        auto index = SiteFile::create(m_context.files, m_staging.path(site::SearchIndexName));
        if (!index)
            return index.status();
        m_staged << site::SearchIndexName;
        writeSearchIndexStart(*index.value());
        for (long long page = 1; page <= pageCount; ++page) {
            const QString name = site::pageFileName(page);
            auto created = SiteFile::create(m_context.files, m_staging.path(name));
            if (!created)
                return created.status();
            m_staged << name;
            SiteFile &file = *created.value();
            file.writeBytes(pageStart(m_layout, page, m_logo ? &*m_logo : nullptr));
            if (page == 1 && m_request.sections)
                file.writeBytes(sectionList(m_sections, perPage));
            file.writeBytes("<main id=\"catalog\">\n");
            const long long first = (page - 1) * perPage;
            for (long long place = first; place < std::min(m_count, page * perPage); ++place) {
                startGroup(file, place, place == first);
                const auto record =
                    m_spool->next(m_request.sections ? streamOf(m_sections[m_section].group) : 0);
                if (!record)
                    return record.status();
                ArticleLength articleLength = 0;
                std::memcpy(&articleLength, record->data(), sizeof articleLength);
                file.writeBytes("<article class=\"item\" id=\"i" + QByteArray::number(place + 1) + "\">\n");
                file.writeBytes(record->sliced(sizeof articleLength, articleLength));
                file.writeBytes("</article>\n");
                writeSearchEntry(*index.value(), record->sliced(sizeof articleLength + articleLength), page,
                                 place + 1, place == 0);
                if (m_meter.tick(m_count + place + 1, m_total))
                    return Stop::Requested;
            }
            file.writeBytes(m_request.sections ? "</div>\n</section>\n</main>\n" : "</div>\n</main>\n");
            file.writeBytes(pageEnd(m_layout, page, pageCount));
            if (const Status closed = file.close(); !closed)
                return closed;
        }
        writeSearchIndexEnd(*index.value());
        if (const Status closed = index.value()->close(); !closed)
            return closed;
        return Stop::No;
    }

    // Opens the grid that the item at `place` goes into: the page's, or with sections its
    // section's under its heading, at the start of a section and again on each page it spans.
    void startGroup(SiteFile &file, long long place, bool pageStart)
    {
        if (!m_request.sections) {
            if (pageStart)
                file.writeBytes("<div class=\"grid\">\n");
            return;
        }
        while (m_sections[m_section].first + m_sections[m_section].count <= place)
            ++m_section;
        const Section &current = m_sections[m_section];
        if (!pageStart && place == current.first)
            file.writeBytes("</div>\n</section>\n");
        if (pageStart || place == current.first)
            file.writeBytes(sectionStart(current));
    }

    Status writeFile(const QString &name, QByteArrayView bytes)
    {
        auto created = SiteFile::create(m_context.files, m_staging.path(name));
        if (!created)
            return created.status();
        m_staged << name;
        created.value()->writeBytes(bytes);
        return created.value()->close();
    }

    RunContext &m_context;
    const SiteRequest &m_request;
    const SiteLayout &m_layout;
    CatalogRows &m_rows;
    ThumbnailStore &m_pictures;
    const SiteStaging &m_staging;
    QHash<qint64, QString> m_groupNames;
    ItemArticle m_article;
    ProgressMeter m_meter;
    long long m_total = 0; // progress: every item read, then every item written
    long long m_count = 0; // the items read
    std::unique_ptr<ItemSpool> m_spool;
    std::vector<std::optional<qint64>> m_groups; // the items' sort groups in catalog order, with sections
    std::map<std::optional<qint64>, std::size_t> m_streams; // a section's stream in the spool
    std::vector<Section> m_sections;
    std::size_t m_section = 0;              // the section being written
    QHash<QString, Thumbnail> m_thumbnails; // picture reference -> its thumbnail
    std::optional<Thumbnail> m_logo;
    QStringList m_staged;
};

// The first page of the site that a stopped or failed run leaves, or the empty text.
QString earlierFirstPage(const FileSystem &files, const QString &folder)
{
    const QString first = withTrailingSeparator(folder) + site::pageFileName(1);
    return files.fileExists(first) ? first : QString();
}

} // namespace

Result<QString> CreateCatSite(RunContext &context, const SiteRequest &request)
{
    ProgressMeter meter(context.user, context.state);
    meter.reset();
    const auto layout = SiteLayout::read(context.settings);
    if (!layout)
        return layout.status();
    QHash<qint64, QString> groupNames;
    if (request.sections) {
        auto names = readSortGroupNames(request.dbFile);
        if (!names)
            return names.status();
        groupNames = std::move(names).value();
    }
    auto rows = CatalogRows::open(request.dbFile, context.settings);
    if (!rows)
        return rows.status();
    if (const Status made = ensureFolder(context.files, request.folder); !made)
        return made;
    auto pictures = ThumbnailStore::open(request.folder);
    if (!pictures)
        return pictures.status();
    const auto staging = SiteStaging::prepare(request.folder);
    if (!staging)
        return staging.status();

    QStringList staged;
    {
        SiteRun run(context, request, layout.value(), *rows.value(), *pictures.value(), staging.value(),
                    std::move(groupNames));
        const auto built = run.build();
        if (!built || built.value() == SiteRun::Stop::Requested) {
            staging->discard();
            // What was made is kept for the next run; a failure to record it is not this run's news.
            (void)pictures.value()->saveRecord(true);
            if (!built)
                return built.status();
            return earlierFirstPage(context.files, request.folder);
        }
        staged = run.staged();
    }
    if (const Status published = staging->publish(context.files, staged); !published)
        return published;
    if (const Status removed = pictures.value()->removeUnused(); !removed)
        return removed;
    if (const Status recorded = pictures.value()->saveRecord(false); !recorded)
        return recorded;
    meter.reset();
    if (staged.isEmpty())
        return QString();
    return withTrailingSeparator(request.folder) + site::pageFileName(1);
}

} // namespace zorbin
