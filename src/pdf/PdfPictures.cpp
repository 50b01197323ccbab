#include "pdf/PdfPictures.h"

#include "platform/FileSystem.h"

#include <QImageReader>
#include <QPainter>
#include <algorithm>
#include <cmath>

namespace zorbin {
namespace {

constexpr double PointsPerCssPixel = 72.0 / 96.0;

// Three bytes a pixel: the run keeps every picture, so a quarter less memory counts.
QImage flattenedOnWhite(QImage image)
{
    if (!image.hasAlphaChannel())
        return image.convertToFormat(QImage::Format_RGB888);
    QImage flat(image.size(), QImage::Format_RGB32);
    flat.fill(Qt::white);
    QPainter painter(&flat);
    painter.drawImage(0, 0, image);
    painter.end();
    return flat.convertToFormat(QImage::Format_RGB888);
}

PdfPicture decode(QIODevice &device, const QSizeF &box, double dotsPerInch)
{
    QImageReader reader(&device);
    reader.setAutoTransform(true);
    const QSize stored = reader.size();
    const bool turned = reader.transformation().testFlag(QImageIOHandler::TransformationRotate90);
    if (stored.isValid() && !stored.isEmpty()) {
        const QSize upright = turned ? stored.transposed() : stored;
        const QSizeF printed = fittedSize(QSizeF(upright) * PointsPerCssPixel, box);
        const double scale = std::min(1.0, printed.width() / 72.0 * dotsPerInch / upright.width());
        if (scale < 1.0) {
            const QSize wanted(std::max(1, static_cast<int>(std::ceil(upright.width() * scale))),
                               std::max(1, static_cast<int>(std::ceil(upright.height() * scale))));
            reader.setScaledSize(turned ? wanted.transposed() : wanted);
        }
    }
    QImage image = reader.read();
    if (image.isNull())
        return {};
    // The natural size is the file's own, whatever size it was decoded at.
    const QSize upright =
        stored.isValid() && !stored.isEmpty() ? (turned ? stored.transposed() : stored) : image.size();
    return {flattenedOnWhite(std::move(image)), QSizeF(upright) * PointsPerCssPixel};
}

} // namespace

void PdfPictures::release(const QString &file)
{
    m_pictures.erase(file);
}

QSizeF fittedSize(const QSizeF &natural, const QSizeF &box)
{
    if (natural.isEmpty() || box.isEmpty())
        return {};
    const double scale = std::min({1.0, box.width() / natural.width(), box.height() / natural.height()});
    return natural * scale;
}

PdfPictures::PdfPictures(const FileSystem &files, QSizeF box, double dotsPerInch)
    : m_files(files), m_box(box), m_dotsPerInch(dotsPerInch)
{}

const PdfPicture *PdfPictures::picture(const QString &file)
{
    auto known = m_pictures.find(file);
    if (known == m_pictures.end()) {
        PdfPicture picture;
        if (auto device = m_files.openForReading(file)) {
            ++m_decoded;
            picture = decode(*device.value(), m_box, m_dotsPerInch);
        }
        known = m_pictures.emplace(file, std::move(picture)).first;
        m_heldAtMost = std::max(m_heldAtMost, static_cast<int>(m_pictures.size()));
    }
    return known->second.image.isNull() ? nullptr : &known->second;
}

} // namespace zorbin
