#include "card/FileChooser.h"

#include <QFileDialog>

namespace zorbin {
namespace {

class SystemFileChooser final : public FileChooser
{
public:
    std::optional<QString> openFile(QWidget *parent, const FileRequest &request) override
    {
        QFileDialog dialog(parent);
        dialog.setFileMode(QFileDialog::ExistingFile);
        dialog.setAcceptMode(QFileDialog::AcceptOpen);
        dialog.setOption(QFileDialog::ReadOnly);
        dialog.setNameFilters(request.nameFilters);
        if (request.selectedFilter >= 0 && request.selectedFilter < request.nameFilters.size())
            dialog.selectNameFilter(request.nameFilters.at(request.selectedFilter));
        if (!request.startPath.isEmpty())
            dialog.selectFile(request.startPath);
        if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty())
            return std::nullopt;
        const QString chosen = QDir::toNativeSeparators(dialog.selectedFiles().constFirst());
        if (chosen.isEmpty())
            return std::nullopt;
        return chosen;
    }

    std::optional<QString> chooseFolder(QWidget *parent, const QString &title,
                                        const QString &startFolder) override
    {
        const QString chosen = QFileDialog::getExistingDirectory(parent, title, startFolder);
        if (chosen.isEmpty())
            return std::nullopt;
        return QDir::toNativeSeparators(chosen);
    }
};

} // namespace

FileChooser &systemFileChooser()
{
    static SystemFileChooser chooser;
    return chooser;
}

} // namespace zorbin
