#pragma once

#include <QWidget>

class QLineEdit;
class QToolButton;

namespace zorbin {

struct CardContext;

// A folder box with a button beside it that opens the folder chooser and puts the chosen
// folder into the box. The box stays the caller's (bound to the settings record).
class FolderField : public QWidget
{
    Q_OBJECT

public:
    // `trailingSeparator`: the chosen folder gets a separator at its end, for settings that are
    // joined directly with a file name (the picture folder). `context` must outlive the field.
    FolderField(QLineEdit *box, const QString &buttonName, const QString &dialogTitle, bool trailingSeparator,
                CardContext &context, QWidget *parent = nullptr);

    QToolButton *button() const { return m_button; }

    // The button's handler: asks for a folder; Cancel leaves the box as it was.
    void chooseFolder();

private:
    QLineEdit *m_box;
    QToolButton *m_button;
    QString m_title;
    bool m_trailingSeparator;
    CardContext &m_context;
};

} // namespace zorbin
