#include "web/ThumbnailStore.h"

#include "platform/Paths.h"
#include "web/SiteNames.h"
#include "web/ThumbnailImages.h"

#include <QCryptographicHash>
#include <QDateTime>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QRegularExpression>
#include <QSaveFile>

namespace zorbin {
namespace {

const QString RecordName = QStringLiteral("thumbnails.txt");
const QString PlaceholderName = QStringLiteral("placeholder.svg");
const QString JpegExtension = QStringLiteral(".jpg");
const QString TwiceSuffix = QStringLiteral("-2x.jpg");
constexpr qsizetype NameLength = 20; // hexadecimal digits: 80 bits, no two pictures of a shop collide

// A light grey box that stretches to any size the page gives it.
constexpr QByteArrayView PlaceholderSvg =
    "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"100\" height=\"100\" viewBox=\"0 0 100 100\" "
    "preserveAspectRatio=\"none\"><rect width=\"100\" height=\"100\" fill=\"#eeeeee\" stroke=\"#cccccc\" "
    "stroke-width=\"2\"/></svg>\n";

// Everything that makes two thumbnails of the same bytes differ. A change of the making that
// changes the pictures must change this text, so that old thumbnails are not taken for new.
QString recipeOf(QSize box)
{
    return QStringLiteral("jpeg quality 80 progressive, upright, on white, box %1x%2, 1x and 2x")
        .arg(box.width())
        .arg(box.height());
}

QString hashOf(QByteArrayView first, QByteArrayView second)
{
    QCryptographicHash hash(QCryptographicHash::Sha1);
    hash.addData(first);
    hash.addData("\n");
    hash.addData(second);
    return QString::fromLatin1(hash.result().toHex());
}

bool isThumbnailName(const QString &name)
{
    static const QRegularExpression pattern(QStringLiteral("^[0-9a-f]{%1}(-2x)?\\.jpg$").arg(NameLength));
    return pattern.match(name).hasMatch();
}

} // namespace

Result<std::unique_ptr<ThumbnailStore>> ThumbnailStore::open(const QString &siteFolder)
{
    const QString folder = withTrailingSeparator(siteFolder) + site::PicturesFolderName;
    if (!QFileInfo(folder).isDir() && !QDir().mkdir(folder))
        return Status::fault(
            QStringLiteral("לא ניתן ליצור את המחיצה %1.").arg(QDir::toNativeSeparators(folder)));
    std::unique_ptr<ThumbnailStore> store(new ThumbnailStore(withTrailingSeparator(folder)));
    store->m_earlier = readThumbnailRecord(store->m_folder + RecordName);
    return store;
}

ThumbnailStore::ThumbnailStore(QString folder) : m_folder(std::move(folder)) {}

Result<Thumbnail> ThumbnailStore::thumbnailOf(const QString &source, QSize box)
{
    const QString recipe = recipeOf(box);
    const QString key = hashOf(recipe.toUtf8(), source.toUtf8());
    if (const auto used = m_used.constFind(key); used != m_used.cend())
        return use(key, used.value());
    const QFileInfo info(source);
    const qint64 bytes = info.size();
    const qint64 modified = info.lastModified().toMSecsSinceEpoch();
    if (const auto known = m_earlier.constFind(key); known != m_earlier.cend() && known->bytes == bytes &&
                                                     known->modified == modified && filesExist(known.value()))
        return use(key, known.value());

    QFile file(source);
    if (!file.open(QIODevice::ReadOnly))
        return placeholder(box); // not recorded: it may be readable next time without changing
    auto made = make(source, file.readAll(), recipe, box);
    if (!made)
        return made.status();
    made->bytes = bytes;
    made->modified = modified;
    return use(key, made.value());
}

Result<RecordedThumbnail> ThumbnailStore::make(const QString &source, const QByteArray &bytes,
                                               const QString &recipe, QSize box)
{
    ++m_decoded;
    RecordedThumbnail entry;
    const std::optional<ThumbnailImages> images = makeThumbnailImages(bytes, box);
    if (!images) {
        entry.size = box;
        return entry;
    }
    entry.name = hashOf(recipe.toUtf8(), bytes).left(NameLength);
    entry.size = images->single.size();
    entry.twice = !images->twice.isNull();
    const auto write = [&](const QImage &image, const QString &fileName) {
        const QByteArray jpeg = thumbnailJpeg(image);
        if (jpeg.isEmpty())
            return Status::fault(QStringLiteral("לא ניתן להקטין את התמונה %1: המקודד של JPEG חסר במערכת.")
                                     .arg(QDir::toNativeSeparators(source)));
        return writeFile(fileName, jpeg);
    };
    if (const Status written = write(images->single, entry.name + JpegExtension); !written)
        return written;
    if (entry.twice) {
        if (const Status written = write(images->twice, entry.name + TwiceSuffix); !written)
            return written;
    }
    return entry;
}

Result<Thumbnail> ThumbnailStore::placeholder(QSize box)
{
    if (!m_usedFiles.contains(PlaceholderName)) {
        if (const Status written = writeFile(PlaceholderName, PlaceholderSvg.toByteArray()); !written)
            return written;
        m_usedFiles.insert(PlaceholderName);
    }
    const QString file = site::PicturesFolderName + QLatin1Char('/') + PlaceholderName;
    return Thumbnail{file, QString(), box};
}

Result<Thumbnail> ThumbnailStore::use(const QString &key, const RecordedThumbnail &entry)
{
    m_used.insert(key, entry);
    if (entry.name.isEmpty())
        return placeholder(entry.size);
    const QString folder = site::PicturesFolderName + QLatin1Char('/');
    Thumbnail thumbnail{folder + entry.name + JpegExtension, QString(), entry.size};
    m_usedFiles.insert(entry.name + JpegExtension);
    if (entry.twice) {
        thumbnail.twiceFile = folder + entry.name + TwiceSuffix;
        m_usedFiles.insert(entry.name + TwiceSuffix);
    }
    return thumbnail;
}

bool ThumbnailStore::filesExist(const RecordedThumbnail &entry) const
{
    if (entry.name.isEmpty())
        return true;
    return QFileInfo(m_folder + entry.name + JpegExtension).isFile() &&
           (!entry.twice || QFileInfo(m_folder + entry.name + TwiceSuffix).isFile());
}

Status ThumbnailStore::writeFile(const QString &name, const QByteArray &bytes)
{
    QSaveFile file(m_folder + name);
    if (!file.open(QIODevice::WriteOnly) || file.write(bytes) != bytes.size() || !file.commit())
        return Status::fault(QStringLiteral("לא ניתן לכתוב את הקובץ %1: %2")
                                 .arg(QDir::toNativeSeparators(m_folder + name), file.errorString()));
    return Status::ok();
}

Status ThumbnailStore::saveRecord(bool keepUnused)
{
    ThumbnailRecord record = m_used;
    if (keepUnused) {
        for (auto entry = m_earlier.cbegin(); entry != m_earlier.cend(); ++entry) {
            if (!record.contains(entry.key()))
                record.insert(entry.key(), entry.value());
        }
    }
    return writeThumbnailRecord(m_folder + RecordName, record);
}

Status ThumbnailStore::removeUnused()
{
    const QStringList names = QDir(m_folder).entryList(QDir::Files | QDir::Hidden);
    for (const QString &name : names) {
        if ((!isThumbnailName(name) && name != PlaceholderName) || m_usedFiles.contains(name))
            continue;
        if (QFile file(m_folder + name); !file.remove())
            return Status::fault(QStringLiteral("לא ניתן למחוק את הקובץ %1: %2")
                                     .arg(QDir::toNativeSeparators(m_folder + name), file.errorString()));
    }
    return Status::ok();
}

} // namespace zorbin
