#include "BenchCatalog.h"

#include "model/CatalogSettings.h"
#include "platform/FileSystem.h"
#include "workdb/RowWriter.h"
#include "workdb/WorkDatabase.h"

#include <QColor>
#include <QImage>
#include <QPainter>

namespace zorbin::bench {

Result<QStringList> makePictures(const QString &folder, int count)
{
    QStringList paths;
    for (int i = 0; i <= count; ++i) {
        const bool logo = i == count;
        const QSize size = logo ? QSize(200, 60) : QSize(100 + (i * 37) % 300, 80 + (i * 53) % 220);
        QImage image(size, QImage::Format_RGB32);
        image.fill(QColor::fromHsv((i * 7) % 360, 160, 230));
        QPainter painter(&image);
        painter.fillRect(size.width() / 4, size.height() / 4, size.width() / 2, size.height() / 2, Qt::white);
        painter.end();
        const QString name = logo ? QStringLiteral("logo.png")
                                  : QStringLiteral("pic%1.%2")
                                        .arg(i, 4, 10, QLatin1Char('0'))
                                        .arg(i % 2 == 0 ? QStringLiteral("png") : QStringLiteral("jpg"));
        const QString path = folder + QLatin1Char('/') + name;
        if (!image.save(path))
            return Status::fault(QStringLiteral("cannot write %1").arg(path));
        paths << path;
    }
    return paths;
}

Status makeWorkDatabase(const QString &path, int items, const QStringList &pictures)
{
    if (const Status created = createWorkDatabase(localFileSystem(), path); !created)
        return created;
    auto work = WorkDatabase::open(path);
    if (!work)
        return work.status();
    if (const Status begun = work.value()->begin(); !begun)
        return begun;
    {
        RowWriter writer(*work.value(), QStringLiteral("tItems"),
                         {QStringLiteral("ItemKey"), QStringLiteral("ItemName"), QStringLiteral("ItemSort"),
                          QStringLiteral("Unit"), QStringLiteral("SellPrice"), QStringLiteral("SellCoin"),
                          QStringLiteral("ItemPic"), QStringLiteral("Include")});
        if (!writer.prepareError().isEmpty())
            return Status::fault(writer.prepareError());
        for (int i = 0; i < items; ++i) {
            const QVariant row[] = {QStringLiteral("%1").arg(i, 6, 10, QLatin1Char('0')),
                                    QStringLiteral("פריט לדוגמה מספר %1").arg(i),
                                    i % 40,
                                    QStringLiteral("יח'"),
                                    1.25 * i,
                                    QStringLiteral("ש\"ח"),
                                    pictures.at(i % pictures.size()),
                                    true};
            if (const WriteOutcome written = writer.write(row); !written)
                return Status::fault(written.description());
        }
    }
    return work.value()->commit();
}

void useBenchSettings(CatalogSettings &settings, const QString &outputFolder, const QString &logo)
{
    settings.outputFolder = outputFolder;
    settings.rows = 8;
    settings.columns = 3;
    settings.pictureWidth = 120;
    settings.pictureHeight = 90;
    settings.topPercent = 10;
    settings.bottomPercent = 8;
    settings.topTitle = QStringLiteral("קטלוג מוצרים");
    settings.topTitle2 = QStringLiteral("מהדורת בדיקה");
    settings.bottomTitle = QStringLiteral("כל הזכויות שמורות");
    settings.logo = logo;
    const QStringList tags{QStringLiteral("0"), QStringLiteral("1"), QStringLiteral("2"), QStringLiteral("4"),
                           QStringLiteral("6")};
    const QStringList captions{QString(), QStringLiteral("מק\"ט"), QString(), QStringLiteral("מחיר"),
                               QStringLiteral("יחידה")};
    for (qsizetype i = 0; i < tags.size(); ++i) {
        settings.lines[static_cast<std::size_t>(i)].field = fieldOfTag(tags.at(i));
        settings.lines[static_cast<std::size_t>(i)].caption = captions.at(i);
    }
    settings.priceList1.clear();
    settings.priceList1.addEntry(QStringLiteral("מחיר מכירה"), 0);
    settings.priceList1.setCurrentIndex(0);
    settings.sortKey = SortKey::ItemKey;
    settings.sortDirection = SortDirection::Ascending;
    settings.pictureLocation = PictureLocation::AsLine;
}

} // namespace zorbin::bench
