#include "source/DatabaseFile.h"

#include <QFile>
#include <QFileInfo>

namespace zorbin {

DatabaseFileKind databaseFileKind(const QString &path)
{
    if (!QFileInfo(path).isFile())
        return DatabaseFileKind::Missing;
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        return DatabaseFileKind::Missing;
    const QByteArray head = file.read(19);
    if (head.startsWith(QByteArray("SQLite format 3\0", 16)))
        return DatabaseFileKind::Sqlite;
    const QByteArray signature = head.mid(4, 15);
    if (signature == "Standard Jet DB" || signature == "Standard ACE DB")
        return DatabaseFileKind::Jet;
    return DatabaseFileKind::Other;
}

} // namespace zorbin
