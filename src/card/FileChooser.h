#pragma once

#include <QString>
#include <QStringList>
#include <optional>

class QWidget;

namespace zorbin {

// The file dialogs of the settings page, behind an interface so that a test can answer them.
class FileChooser
{
public:
    struct FileRequest
    {
        QStringList nameFilters; // Qt's form: "Caption (*.a *.b)"
        int selectedFilter = 0;  // index into nameFilters of the filter offered first
        QString startPath;       // a file or folder to start from; empty for the dialog's own choice
    };

    virtual ~FileChooser() = default;

    // The full path of the chosen file, exactly as the dialog returns it; nothing on Cancel.
    virtual std::optional<QString> openFile(QWidget *parent, const FileRequest &request) = 0;
    // The chosen folder; nothing on Cancel.
    virtual std::optional<QString> chooseFolder(QWidget *parent, const QString &title,
                                                const QString &startFolder) = 0;
};

// The platform's file dialogs.
FileChooser &systemFileChooser();

} // namespace zorbin
