#include "web/ThumbnailRecord.h"

#include <QDir>
#include <QFile>
#include <QRegularExpression>
#include <QSaveFile>
#include <algorithm>
#include <array>

namespace zorbin {
namespace {

constexpr int FieldCount = 7;

} // namespace

ThumbnailRecord readThumbnailRecord(const QString &path)
{
    ThumbnailRecord record;
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        return record;
    // Only a hash or the thumbnail's own name: a damaged record must not name other files.
    static const QRegularExpression hex(QStringLiteral("^[0-9a-f]{20,40}$"));
    const QString text = QString::fromUtf8(file.readAll());
    for (const QString &line : text.split(QLatin1Char('\n'), Qt::SkipEmptyParts)) {
        const QStringList fields = line.split(QLatin1Char('\t'));
        if (fields.size() != FieldCount || !hex.match(fields[0]).hasMatch())
            continue;
        std::array<bool, 5> numbers{};
        RecordedThumbnail entry;
        entry.bytes = fields[1].toLongLong(&numbers[0]);
        entry.modified = fields[2].toLongLong(&numbers[1]);
        entry.name = fields[3];
        entry.size = QSize(fields[4].toInt(&numbers[2]), fields[5].toInt(&numbers[3]));
        entry.twice = fields[6].toInt(&numbers[4]) == 1;
        if (!std::ranges::all_of(numbers, [](bool number) { return number; }) || entry.size.isEmpty() ||
            (!entry.name.isEmpty() && !hex.match(entry.name).hasMatch()))
            continue;
        record.insert(fields[0], entry);
    }
    return record;
}

Status writeThumbnailRecord(const QString &path, const ThumbnailRecord &record)
{
    QSaveFile file(path);
    const auto failed = [&] {
        return Status::fault(QStringLiteral("לא ניתן לכתוב את הקובץ %1: %2")
                                 .arg(QDir::toNativeSeparators(path), file.errorString()));
    };
    if (!file.open(QIODevice::WriteOnly))
        return failed();
    QByteArray text;
    for (auto entry = record.cbegin(); entry != record.cend(); ++entry) {
        const RecordedThumbnail &known = entry.value();
        text += entry.key().toUtf8() + '\t' + QByteArray::number(known.bytes) + '\t' +
                QByteArray::number(known.modified) + '\t' + known.name.toUtf8() + '\t' +
                QByteArray::number(known.size.width()) + '\t' + QByteArray::number(known.size.height()) +
                '\t' + (known.twice ? '1' : '0') + '\n';
    }
    if (file.write(text) != text.size() || !file.commit())
        return failed();
    return Status::ok();
}

} // namespace zorbin
