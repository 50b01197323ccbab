#include "card/tabs/TitlesTab.h"

#include "card/CardContext.h"
#include "card/FileChooser.h"
#include "card/SettingsBinder.h"
#include "card/tabs/TabBuilding.h"
#include "control/CatalogControl.h"

#include <QCheckBox>
#include <QFileInfo>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QImageReader>
#include <QLineEdit>
#include <QStyle>
#include <QToolButton>
#include <QVBoxLayout>

namespace zorbin {

using tabs::named;

namespace {

constexpr int LogoPreviewSize = 24;

} // namespace

TitlesTab::TitlesTab(CardContext &context, QWidget *parent) : QWidget(parent), m_context(context)
{
    setObjectName(QStringLiteral("TitlesTab"));
    auto *layout = new QVBoxLayout(this);
    layout->addWidget(buildTitles());
    layout->addWidget(buildBands());
    layout->addStretch();
}

QWidget *TitlesTab::buildTitles()
{
    SettingsBinder &bind = m_context.binder;
    auto *group = new QGroupBox(QStringLiteral("כותרות"), this);
    auto *top = named<QLineEdit>(QStringLiteral("txtTopTitle"), group);
    auto *second = named<QLineEdit>(QStringLiteral("txtTopTitle2"), group);
    auto *bottom = named<QLineEdit>(QStringLiteral("txtBottomTitle"), group);
    m_txtLogo = named<QLineEdit>(QStringLiteral("txtLogo"), group);
    bind.text(top, QStringLiteral("TopTitle"));
    bind.text(second, QStringLiteral("TopTitle2"));
    bind.text(bottom, QStringLiteral("BottomTitle"));
    bind.text(m_txtLogo, QStringLiteral("Logo"));
    tabs::showLeftToRight(m_txtLogo);

    m_imgLogo = named<QToolButton>(QStringLiteral("imgLogo"), group);
    m_imgLogo->setToolTip(QStringLiteral("בחירת קובץ הסמל"));
    m_imgLogo->setAccessibleName(QStringLiteral("בחירת קובץ הסמל"));
    m_imgLogo->setIconSize(QSize(LogoPreviewSize, LogoPreviewSize));
    m_imgLogo->setAutoRaise(false);
    connect(m_imgLogo, &QToolButton::clicked, this, &TitlesTab::imgLogo_Click);
    connect(m_txtLogo, &QLineEdit::textChanged, this, &TitlesTab::showLogo);
    showLogo();

    auto *logo = new QWidget(group);
    auto *logoRow = new QHBoxLayout(logo);
    logoRow->setContentsMargins(0, 0, 0, 0);
    logoRow->addWidget(m_txtLogo, 1);
    logoRow->addWidget(m_imgLogo);

    auto *grid = new QGridLayout(group);
    tabs::addFieldRow(grid, 0, QStringLiteral("כותרת עליונה:"), top);
    tabs::addFieldRow(grid, 1, QStringLiteral("כותרת עליונה משנית:"), second);
    tabs::addFieldRow(grid, 2, QStringLiteral("כותרת תחתונה:"), bottom);
    tabs::addFieldRow(grid, 3, QStringLiteral("סמל (לוגו):"), m_txtLogo, logo);
    auto *sections = named<QCheckBox>(QStringLiteral("chkWebSections"),
                                      QStringLiteral("באתר: הפריטים בחלוקה לפי קבוצות מיון"), group);
    bind.check(sections, QStringLiteral("WebSections"));
    grid->addWidget(sections, 4, 1);
    grid->setColumnStretch(1, 1);
    return group;
}

QWidget *TitlesTab::buildBands()
{
    auto *group = new QGroupBox(QStringLiteral("גובה רצועות הכותרת"), this);
    auto *top = named<QLineEdit>(QStringLiteral("txtTopPercent"), group);
    auto *bottom = named<QLineEdit>(QStringLiteral("txtBottomPercent"), group);
    m_context.binder.number(top, QStringLiteral("TopPercent"), tabs::MaxLengthPercent);
    m_context.binder.number(bottom, QStringLiteral("BottomPercent"), tabs::MaxLengthPercent);

    auto *grid = new QGridLayout(group);
    tabs::addFieldRow(grid, 0, QStringLiteral("גובה הכותרת העליונה:"), top);
    grid->addWidget(new QLabel(QStringLiteral("אחוז מהעמוד"), group), 0, 2);
    tabs::addFieldRow(grid, 1, QStringLiteral("גובה הכותרת התחתונה:"), bottom);
    grid->addWidget(new QLabel(QStringLiteral("אחוז מהעמוד"), group), 1, 2);
    grid->setColumnStretch(3, 1);
    return group;
}

void TitlesTab::imgLogo_Click()
{
    FileChooser::FileRequest request;
    request.nameFilters = {QStringLiteral("All Files (*.*)"),
                           QStringLiteral("Image files (GIF,JPG,PNG) (*.GIF *.JPG *.JPEG *.PNG)")};
    request.selectedFilter = 1; // the picture files are offered first
    request.startPath = m_lastLogoChoice;
    const auto chosen = m_context.files->openFile(window(), request);
    if (!chosen || chosen->isEmpty())
        return;
    m_lastLogoChoice = *chosen;
    m_txtLogo->setText(*chosen);
}

void TitlesTab::showLogo()
{
    // The button shows the logo itself once it names a picture that can be read.
    QImageReader reader(m_txtLogo->text());
    reader.setAutoTransform(true);
    QImage logo;
    if (!m_txtLogo->text().isEmpty() && QFileInfo(m_txtLogo->text()).isFile())
        logo = reader.read();
    if (logo.isNull()) {
        m_imgLogo->setIcon(style()->standardIcon(QStyle::SP_DirOpenIcon));
        return;
    }
    m_imgLogo->setIcon(QPixmap::fromImage(
        logo.scaled(LogoPreviewSize, LogoPreviewSize, Qt::KeepAspectRatio, Qt::SmoothTransformation)));
}

} // namespace zorbin
