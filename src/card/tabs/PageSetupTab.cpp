#include "card/tabs/PageSetupTab.h"

#include "card/CardContext.h"
#include "card/SettingsBinder.h"
#include "card/tabs/TabBuilding.h"
#include "control/CatalogControl.h"
#include "dialogs/CellLineEditor.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QVBoxLayout>

namespace zorbin {

using tabs::captionFor;
using tabs::named;

PageSetupTab::PageSetupTab(CardContext &context, QWidget *parent) : QWidget(parent), m_context(context)
{
    setObjectName(QStringLiteral("PageSetupTab"));
    m_editor = new CellLineEditor(context.control.settings().lines, context.binder, this);

    auto *side = new QVBoxLayout;
    side->addWidget(buildPage());
    side->addWidget(buildPictureSize());
    auto *onlyWithPicture =
        named<QCheckBox>(QStringLiteral("ChkOnlyWithPic"), QStringLiteral("רק פריטים שיש להם תמונה"), this);
    context.binder.check(onlyWithPicture, context.control.settings().ChkOnlyWithPic);
    side->addWidget(onlyWithPicture);
    side->addStretch();

    auto *layout = new QHBoxLayout(this);
    layout->addWidget(m_editor, 1);
    layout->addLayout(side);
}

QWidget *PageSetupTab::buildPage()
{
    CatalogSettings &settings = m_context.control.settings();
    SettingsBinder &bind = m_context.binder;
    auto *group = new QGroupBox(QStringLiteral("עמוד הקטלוג"), this);
    auto *rows = named<QLineEdit>(QStringLiteral("txtRows"), group);
    auto *cols = named<QLineEdit>(QStringLiteral("txtCols"), group);
    auto *split = named<QComboBox>(QStringLiteral("cmbPageSplit"), group);
    auto *location = named<QComboBox>(QStringLiteral("cmbPicLocation"), group);
    auto *rules = named<QCheckBox>(QStringLiteral("chkRules"), QStringLiteral("מסגרת סביב כל פריט?"), group);
    bind.number(rows, settings.txtRows, MaxLengthGridSize, NumericSetting::Rows);
    bind.number(cols, settings.txtCols, MaxLengthGridSize, NumericSetting::Cols);
    bind.choice(split, settings.cmbPageSplit);
    bind.choice(location, settings.cmbPicLocation);
    bind.check(rules, settings.chkRules);
    tabs::fitToCharacters(rows, MaxLengthGridSize);
    tabs::fitToCharacters(cols, MaxLengthGridSize);

    auto *grid = new QGridLayout(group);
    grid->addWidget(captionFor(QStringLiteral("שורות:"), rows, group), 0, 0);
    grid->addWidget(rows, 0, 1, Qt::AlignLeading);
    grid->addWidget(captionFor(QStringLiteral("עמודות:"), cols, group), 1, 0);
    grid->addWidget(cols, 1, 1, Qt::AlignLeading);
    grid->addWidget(captionFor(QStringLiteral("קבצים:"), split, group), 2, 0);
    grid->addWidget(split, 2, 1);
    grid->addWidget(captionFor(QStringLiteral("מיקום התמונה:"), location, group), 3, 0);
    grid->addWidget(location, 3, 1);
    grid->addWidget(rules, 4, 0, 1, 2);
    return group;
}

QWidget *PageSetupTab::buildPictureSize()
{
    CatalogSettings &settings = m_context.control.settings();
    auto *group = new QGroupBox(QStringLiteral("גודל מקסימלי לתמונה: (בנקודות)"), this);
    auto *height = named<QLineEdit>(QStringLiteral("txtImageH"), group);
    auto *width = named<QLineEdit>(QStringLiteral("txtImageW"), group);
    m_context.binder.number(height, settings.txtImageH, MaxLengthPictureSize, NumericSetting::ImageH);
    m_context.binder.number(width, settings.txtImageW, MaxLengthPictureSize, NumericSetting::ImageW);
    tabs::fitToCharacters(height, MaxLengthPictureSize);
    tabs::fitToCharacters(width, MaxLengthPictureSize);
    height->setPlaceholderText(QStringLiteral("ללא"));
    width->setPlaceholderText(QStringLiteral("ללא"));
    auto *layout = new QHBoxLayout(group);
    layout->addWidget(captionFor(QStringLiteral("גובה:"), height, group));
    layout->addWidget(height);
    layout->addSpacing(12);
    layout->addWidget(captionFor(QStringLiteral("רוחב:"), width, group));
    layout->addWidget(width);
    layout->addStretch();
    return group;
}

} // namespace zorbin
