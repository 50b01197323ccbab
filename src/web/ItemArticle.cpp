#include "web/ItemArticle.h"

#include "model/CatalogField.h"
#include "output/CatalogRows.h"
#include "output/FileNaming.h"
#include "web/SearchIndex.h"
#include "web/SiteLayout.h"
#include "web/ThumbnailStore.h"

namespace zorbin {
namespace {

// The working database's mark for a missing text value; as a picture reference it means none.
const QString MissingMark = QStringLiteral("?");

bool isPrice(int field)
{
    return field == 4 || field == 5;
}

void appendEscaped(QByteArray &out, const QString &text)
{
    out += escapeHtml(text).toUtf8();
}

} // namespace

ItemArticle::ItemArticle(const SiteLayout &layout, const CatalogRows &rows, Separators separators)
    : m_rows(rows), m_separators(std::move(separators)), m_key(rows.column(QStringLiteral("ItemKey"))),
      m_name(rows.column(QStringLiteral("ItemName"))), m_sort(rows.column(QStringLiteral("ItemSort"))),
      m_picture(rows.column(QStringLiteral("ItemPic")))
{
    for (const SiteLine &line : layout.lines) {
        Line prepared;
        prepared.field = line.field;
        prepared.value = rows.column(line.column);
        if (isPrice(line.field))
            prepared.coin = rows.column(QStringLiteral("Coin") + QString::number(line.field - 3));
        QString start = QStringLiteral("<div class=\"L") + QString::number(line.index);
        if (line.field == PictureField)
            start += QStringLiteral(" pic");
        start += QStringLiteral("\">");
        if (!line.caption.isEmpty())
            start += QStringLiteral("<span class=\"caption\">") + line.caption + QStringLiteral("</span>");
        prepared.start = start.toUtf8();
        m_lines.push_back(prepared);
    }
}

QString ItemArticle::pictureReference() const
{
    const QVariant value = m_rows.value(m_picture);
    const QString reference = value.isNull() ? QString() : value.toString();
    return reference == MissingMark ? QString() : reference;
}

std::optional<qint64> ItemArticle::sortGroup() const
{
    const QVariant value = m_rows.value(m_sort);
    if (value.isNull())
        return std::nullopt;
    return value.toLongLong();
}

Status ItemArticle::write(const Thumbnail *picture, QByteArray &article, QByteArray &entry) const
{
    const QVariant name = m_rows.value(m_name);
    const QString nameText = name.isNull() ? QString() : name.toString();
    for (const Line &line : m_lines) {
        const QVariant value = m_rows.value(line.value);
        if (line.field == PictureField) {
            article += line.start;
            writePicture(picture, nameText, article);
        } else if (isPrice(line.field)) {
            const auto amount = NumOrZero(value);
            if (!amount)
                return amount.status();
            article += line.start;
            article += "<bdi>" + formatAmount(amount.value(), m_separators).toUtf8() + "</bdi> ";
            if (const QVariant coin = m_rows.value(line.coin); !coin.isNull())
                appendEscaped(article, coin.toString());
        } else if (value.isNull()) {
            article += line.start;
            article += "&nbsp;";
        } else {
            article += line.start;
            article += "<bdi>";
            appendEscaped(article, value.toString());
            article += "</bdi>";
        }
        article += "</div>\n";
    }
    const QVariant key = m_rows.value(m_key);
    entry += searchEntryStart(key.isNull() ? QString() : key.toString(), nameText, picture);
    return Status::ok();
}

void ItemArticle::writePicture(const Thumbnail *picture, const QString &name, QByteArray &article) const
{
    if (!picture)
        return;
    article += "<img alt=\"";
    appendEscaped(article, name);
    article += imageAttributes(*picture);
}

const QByteArray &ItemArticle::imageAttributes(const Thumbnail &picture) const
{
    if (const auto known = m_images.constFind(picture.file); known != m_images.cend())
        return known.value();
    QByteArray attributes = "\" src=\"" + picture.file.toUtf8() + '"';
    if (!picture.twiceFile.isEmpty())
        attributes += " srcset=\"" + picture.file.toUtf8() + " 1x, " + picture.twiceFile.toUtf8() + " 2x\"";
    attributes += " width=\"" + QByteArray::number(picture.size.width()) + "\" height=\"" +
                  QByteArray::number(picture.size.height()) + "\" loading=\"lazy\">";
    return m_images.insert(picture.file, attributes).value();
}

} // namespace zorbin
