#include "output/FileNaming.h"

#include "common/Numbers.h"
#include "platform/HtmlReference.h"
#include "platform/Paths.h"

#include <QRegularExpression>

namespace zorbin {

QString HTMLFileName(const QString &pPrefix, std::int64_t Z)
{
    if (Z == 1)
        return pPrefix + QStringLiteral("index.htm");
    return pPrefix + QStringLiteral("%1").arg(Z, 6, 10, QLatin1Char('0')) + QStringLiteral(".htm");
}

QString ImageFileName(const QString &pImagePath, const QString &pOrigImage)
{
    if (pOrigImage.isEmpty())
        return {};
    const qsizetype lastSeparator = pOrigImage.lastIndexOf(pathSeparator());
    return pImagePath + pathSeparator() + pOrigImage.mid(lastSeparator + 1);
}

QString HTMLText(const QVariant &value)
{
    if (value.isNull())
        return QStringLiteral("&nbsp;");
    return escapeHtml(value.toString());
}

bool HasHebrew(const QString &text)
{
    for (const QChar c : text) {
        if (c.unicode() >= 0x05D0 && c.unicode() <= 0x05EA)
            return true;
    }
    return false;
}

Result<double> NumOrZero(const QVariant &value)
{
    if (value.isNull())
        return 0.0;
    switch (value.typeId()) {
    case QMetaType::Double:
    case QMetaType::Float:
    case QMetaType::Int:
    case QMetaType::UInt:
    case QMetaType::LongLong:
    case QMetaType::ULongLong:
    case QMetaType::Bool:
        return value.toDouble();
    default:
        break;
    }
    if (const auto number = parseNumber(value.toString()))
        return *number;
    return Status::fault(
        QStringLiteral("הערך \"%1\" במסד הנתונים של הקטלוג אינו מספר.").arg(value.toString()));
}

QString escapeHtml(const QString &text)
{
    QString escaped;
    escaped.reserve(text.size());
    for (const QChar c : text) {
        if (const QLatin1StringView reference = htmlReference(c.unicode()); !reference.isEmpty())
            escaped += reference;
        else
            escaped += c;
    }
    return escaped;
}

namespace {

// A reference that names its scheme ("http://host/p.php?id=5&s=1#x"): its "?", "#" and "%" are
// the URL's own and must reach the browser as they stand.
bool isUrl(const QString &reference)
{
    static const QRegularExpression scheme(QStringLiteral("^[A-Za-z][A-Za-z0-9+.-]*://"));
    return scheme.match(reference).hasMatch();
}

} // namespace

QString attributeFileReference(const QString &path)
{
    if (isUrl(path))
        return escapeHtml(path);
    QString encoded;
    encoded.reserve(path.size());
    for (const QChar c : path) {
        switch (c.unicode()) {
        case u'%':
            encoded += QStringLiteral("%25");
            break;
        case u'#':
            encoded += QStringLiteral("%23");
            break;
        case u'?':
            encoded += QStringLiteral("%3F");
            break;
        default:
            encoded += c;
            break;
        }
    }
    return escapeHtml(encoded);
}

} // namespace zorbin
