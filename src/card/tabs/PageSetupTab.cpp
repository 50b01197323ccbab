#include "card/tabs/PageSetupTab.h"

#include "card/CardContext.h"
#include "card/SettingsBinder.h"
#include "card/tabs/TabBuilding.h"
#include "control/CatalogControl.h"
#include "card/CellLineEditor.h"

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

    auto *grid = new QGridLayout(group);
    tabs::addFieldRow(grid, 0, QStringLiteral("שורות:"), rows, nullptr, Qt::AlignLeading);
    tabs::addFieldRow(grid, 1, QStringLiteral("עמודות:"), cols, nullptr, Qt::AlignLeading);
    tabs::addFieldRow(grid, 2, QStringLiteral("קבצים:"), split);
    tabs::addFieldRow(grid, 3, QStringLiteral("מיקום התמונה:"), location);
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
