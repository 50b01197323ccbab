#include "CameraPictures.h"

#include <QColor>
#include <QFileInfo>
#include <QImage>
#include <QPainter>

namespace zorbin::bench {

Result<QStringList> makeCameraPictures(const QString &folder, int count, QSize size)
{
    QStringList paths;
    QImage image(size, QImage::Format_RGB32);
    for (int i = 0; i < count; ++i) {
        const QString path = folder + QStringLiteral("/photo%1.jpg").arg(i, 4, 10, QLatin1Char('0'));
        paths << path;
        if (QFileInfo(path).size() > 0)
            continue;
        // A gradient and shapes: a photograph's spread of detail, so that decoding costs what it would.
        QPainter painter(&image);
        QLinearGradient gradient(0, 0, size.width(), size.height());
        gradient.setColorAt(0, QColor::fromHsv((i * 7) % 360, 120, 240));
        gradient.setColorAt(1, QColor::fromHsv((i * 7 + 120) % 360, 200, 90));
        painter.fillRect(image.rect(), gradient);
        for (int shape = 0; shape < 12; ++shape) {
            painter.setBrush(QColor::fromHsv((i * 13 + shape * 29) % 360, 180, 200));
            painter.drawEllipse(
                QPoint((i * 97 + shape * 331) % size.width(), (i * 61 + shape * 157) % size.height()),
                60 + shape * 9, 40 + shape * 7);
        }
        painter.end();
        if (!image.save(path, "JPEG", 85))
            return Status::fault(QStringLiteral("cannot write %1").arg(path));
    }
    return paths;
}

} // namespace zorbin::bench
