#pragma once

#include <QWidget>

class QLineEdit;
class QToolButton;

namespace zorbin {

struct CardContext;

// The page titles tab ("כותרות לעמוד"): the top, secondary and bottom titles, the logo file
// with its chooser (`imgLogo`), and the heights of the top and bottom bands.
class TitlesTab : public QWidget
{
    Q_OBJECT

public:
    // `context` must outlive the tab.
    explicit TitlesTab(CardContext &context, QWidget *parent = nullptr);

    // The logo chooser: an open-file dialog offering image files first; the chosen file's full
    // path goes into `txtLogo`. Cancel changes nothing.
    void imgLogo_Click();

private:
    QWidget *buildTitles();
    QWidget *buildBands();
    void showLogo();

    CardContext &m_context;
    QLineEdit *m_txtLogo = nullptr;
    QToolButton *m_imgLogo = nullptr;
    QString m_lastLogoChoice; // the dialog starts where it last left off
};

} // namespace zorbin
