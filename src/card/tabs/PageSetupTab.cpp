#include "card/tabs/PageSetupTab.h"

#include "card/CardContext.h"
#include "card/CellLineEditor.h"
#include "card/SettingsBinder.h"
#include "card/tabs/TabBuilding.h"
#include "control/CatalogControl.h"
#include "model/GridSize.h"

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
    context.binder.check(onlyWithPicture, context.control.settings().onlyWithPicture);
    side->addWidget(onlyWithPicture);
    side->addStretch();

    auto *layout = new QHBoxLayout(this);
    layout->addWidget(m_editor, 1);
    layout->addLayout(side);
}

QWidget *PageSetupTab::buildPage()
{
    SettingsBinder &bind = m_context.binder;
    auto *group = new QGroupBox(QStringLiteral("עמוד הקטלוג"), this);
    auto *rows = named<QLineEdit>(QStringLiteral("txtRows"), group);
    auto *cols = named<QLineEdit>(QStringLiteral("txtCols"), group);
    auto *split = named<QComboBox>(QStringLiteral("cmbPageSplit"), group);
    auto *location = named<QComboBox>(QStringLiteral("cmbPicLocation"), group);
    auto *rules = named<QCheckBox>(QStringLiteral("chkRules"), QStringLiteral("מסגרת סביב כל פריט?"), group);
    bind.number(rows, QStringLiteral("Rows"), tabs::MaxLengthGridSize,
                [](const std::optional<int> &typed) { return gridCountProblem(GridCount::Rows, typed); });
    bind.number(cols, QStringLiteral("Cols"), tabs::MaxLengthGridSize,
                [](const std::optional<int> &typed) { return gridCountProblem(GridCount::Columns, typed); });
    bind.choice(split, QStringLiteral("PageSplit"),
                {QStringLiteral("קובץ אחד"), QStringLiteral("קובץ לעמוד")});
    bind.choice(location, QStringLiteral("PicLocation"),
                {QStringLiteral("בהתאם לטבלה"), QStringLiteral("מימין לנתונים")});
    bind.check(rules, QStringLiteral("Rules"));

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
    auto *group = new QGroupBox(QStringLiteral("גודל מקסימלי לתמונה: (בנקודות)"), this);
    auto *height = named<QLineEdit>(QStringLiteral("txtImageH"), group);
    auto *width = named<QLineEdit>(QStringLiteral("txtImageW"), group);
    m_context.binder.number(height, QStringLiteral("ImageH"), tabs::MaxLengthPictureSize);
    m_context.binder.number(width, QStringLiteral("ImageW"), tabs::MaxLengthPictureSize);
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
