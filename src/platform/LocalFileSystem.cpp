#include "platform/FileSystem.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

namespace zorbin {
namespace {

QString native(const QString &path)
{
    return QDir::toNativeSeparators(path);
}

class LocalFileSystem final : public FileSystem
{
public:
    bool fileExists(const QString &path) const override
    {
        const QFileInfo info(path);
        return info.exists() && info.isFile();
    }

    bool folderExists(const QString &path) const override { return QFileInfo(path).isDir(); }

    std::optional<QString> findFile(const QString &path) const override
    {
        if (path.isEmpty())
            return std::nullopt;
        if (fileExists(path))
            return path;
#ifdef Q_OS_WIN
        return std::nullopt;
#else
        const QFileInfo info(path);
        const QDir folder = info.dir();
        if (!folder.exists())
            return std::nullopt;
        const QString wanted = info.fileName();
        const auto names = folder.entryList(QDir::Files | QDir::Hidden | QDir::System);
        for (const QString &name : names) {
            if (name.compare(wanted, Qt::CaseInsensitive) == 0)
                return folder.filePath(name);
        }
        return std::nullopt;
#endif
    }

    Status makeFolder(const QString &path) override
    {
        // "c:\\out\\" names the folder "out": its parent is the folder above it.
        const QString folder = QDir::cleanPath(QDir::fromNativeSeparators(path));
        const QFileInfo info(folder);
        if (info.isDir())
            return Status::ok();
        if (!QFileInfo(info.absolutePath()).isDir())
            return Status::fault(
                QStringLiteral("לא ניתן ליצור את המחיצה %1: המחיצה שמעליה אינה קיימת.").arg(native(path)));
        if (!QDir().mkdir(folder))
            return Status::fault(QStringLiteral("לא ניתן ליצור את המחיצה %1.").arg(native(path)));
        return Status::ok();
    }

    Status removeFile(const QString &path) override
    {
        QFile file(path);
        if (!file.exists())
            return Status::ok();
        if (!file.remove())
            return Status::fault(
                QStringLiteral("לא ניתן למחוק את הקובץ %1: %2").arg(native(path), file.errorString()));
        return Status::ok();
    }

    Status copyFile(const QString &from, const QString &to) override
    {
        if (QFileInfo(from).absoluteFilePath() == QFileInfo(to).absoluteFilePath())
            return Status::ok();
        if (const Status removed = removeFile(to); !removed)
            return removed;
        // A plain stream copy: QFile::copy syncs every copy to the disk, which makes the
        // thousand pictures of a catalog take seconds; a catalog copy needs no such guarantee.
        QFile source(from);
        QFile target(to);
        const auto failed = [&](const QFile &file) {
            return Status::fault(QStringLiteral("לא ניתן להעתיק את הקובץ %1 אל %2: %3")
                                     .arg(native(from), native(to), file.errorString()));
        };
        if (!source.open(QIODevice::ReadOnly))
            return failed(source);
        if (!target.open(QIODevice::WriteOnly | QIODevice::Truncate))
            return failed(target);
        QByteArray block(64 * 1024, Qt::Uninitialized);
        for (;;) {
            const qint64 read = source.read(block.data(), block.size());
            if (read < 0 || (read > 0 && target.write(block.constData(), read) != read) || !target.flush()) {
                const Status status = failed(read < 0 ? source : target);
                target.remove();
                return status;
            }
            if (read == 0)
                return Status::ok();
        }
    }

    QStringList fileNames(const QString &folder) const override
    {
        return QDir(folder).entryList(QDir::Files | QDir::Hidden | QDir::System, QDir::Name);
    }

    Result<std::unique_ptr<QIODevice>> openForReading(const QString &path) const override
    {
        auto file = std::make_unique<QFile>(path);
        if (!file->open(QIODevice::ReadOnly))
            return Status::fault(
                QStringLiteral("לא ניתן לקרוא את הקובץ %1: %2").arg(native(path), file->errorString()));
        return std::unique_ptr<QIODevice>(std::move(file));
    }

    Result<std::unique_ptr<QIODevice>> openForWriting(const QString &path) override
    {
        return open(path, QIODevice::WriteOnly | QIODevice::Truncate);
    }

    Result<std::unique_ptr<QIODevice>> openForAppending(const QString &path) override
    {
        return open(path, QIODevice::WriteOnly | QIODevice::Append);
    }

private:
    static Result<std::unique_ptr<QIODevice>> open(const QString &path, QIODevice::OpenMode mode)
    {
        auto file = std::make_unique<QFile>(path);
        if (!file->open(mode))
            return Status::fault(
                QStringLiteral("לא ניתן לכתוב את הקובץ %1: %2").arg(native(path), file->errorString()));
        return std::unique_ptr<QIODevice>(std::move(file));
    }
};

} // namespace

FileSystem &localFileSystem()
{
    static LocalFileSystem instance;
    return instance;
}

} // namespace zorbin
