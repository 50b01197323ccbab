#include "card/tabs/RangeTab.h"

#include "card/CardContext.h"
#include "card/SettingsBinder.h"
#include "card/tabs/TabBuilding.h"
#include "control/CatalogControl.h"
#include "dialogs/SelectItemDialog.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace zorbin {

using tabs::captionFor;
using tabs::named;

RangeTab::RangeTab(CardContext &context, QWidget *parent) : QWidget(parent), m_context(context)
{
    setObjectName(QStringLiteral("RangeTab"));
    auto *layout = new QVBoxLayout(this);
    layout->addWidget(buildRanges());
    layout->addWidget(buildOrder());
    layout->addWidget(buildSelection());
    layout->addStretch();
}

QWidget *RangeTab::buildRanges()
{
    CatalogSettings &settings = m_context.control.settings();
    SettingsBinder &bind = m_context.binder;
    auto *group = new QGroupBox(QStringLiteral("אילו פריטים ייכללו בקטלוג"), this);
    auto *grid = new QGridLayout(group);
    grid->addWidget(new QLabel(QStringLiteral("בחירת פריטים מתוך הטווח:"), group), 0, 0, 1, 5);

    auto range = [&](int row, const QString &checkName, const QString &checkCaption, const QString &useKey,
                     const QString &fromName, const QString &fromKey, const QString &toName,
                     const QString &toKey, int maxLength) {
        auto *useBox = named<QCheckBox>(checkName, checkCaption, group);
        auto *fromBox = named<QLineEdit>(fromName, group);
        auto *toBox = named<QLineEdit>(toName, group);
        bind.check(useBox, useKey);
        // Only the upper bound has an entry limit; the lower one takes a key of any length.
        bind.text(fromBox, fromKey);
        bind.text(toBox, toKey, maxLength);
        fromBox->setAccessibleName(checkCaption);
        tabs::fitToCharacters(fromBox, maxLength, QLatin1Char('0'));
        tabs::fitToCharacters(toBox, maxLength, QLatin1Char('0'));
        grid->addWidget(useBox, row, 0);
        grid->addWidget(fromBox, row, 1);
        grid->addWidget(captionFor(QStringLiteral("עד:"), toBox, group), row, 2);
        grid->addWidget(toBox, row, 3);
    };
    range(1, QStringLiteral("ChkCatCode"), QStringLiteral("מקוד מיון:"), QStringLiteral("UseCatCode"),
          QStringLiteral("txtFromSort"), QStringLiteral("FromSort"), QStringLiteral("txtToSort"),
          QStringLiteral("ToSort"), tabs::MaxLengthSortBound);
    range(2, QStringLiteral("ChkItemKey"), QStringLiteral("מפריט:"), QStringLiteral("UseItemKey"),
          QStringLiteral("txtFromItem"), QStringLiteral("FromItem"), QStringLiteral("txtToItem"),
          QStringLiteral("ToItem"), tabs::MaxLengthItemBound);

    auto *filter = named<QCheckBox>(QStringLiteral("chkFilter"), QStringLiteral("חתך:"), group);
    bind.check(filter, QStringLiteral("UseFilter"));
    filter->setToolTip(QStringLiteral("תו בכל מקום בשדה המיון של הפריט; \"*\" מתאים לכל תו"));
    auto *pattern = new QWidget(group);
    auto *positions = new QHBoxLayout(pattern);
    positions->setContentsMargins(0, 0, 0, 0);
    positions->setSpacing(2);
    for (int position = 1; position <= CutOffPositions; ++position) {
        auto *box = named<QLineEdit>(QStringLiteral("ItemCutOff(%1)").arg(position), pattern);
        // Positions beyond the stored ones keep what is typed until the program ends.
        const auto index = static_cast<std::size_t>(position - 1);
        if (position <= StoredCutOffPositions)
            bind.text(box, QStringLiteral("CutOff%1").arg(position), tabs::MaxLengthCutOff);
        else
            bind.text(box, settings.cutOff[index], tabs::MaxLengthCutOff);
        box->setAlignment(Qt::AlignCenter);
        box->setAccessibleName(QStringLiteral("חתך, מקום %1").arg(position));
        tabs::fitToCharacters(box, 1);
        positions->addWidget(box);
    }
    positions->addStretch();
    grid->addWidget(filter, 3, 0);
    grid->addWidget(pattern, 3, 1, 1, 4);
    grid->setColumnStretch(4, 1);
    return group;
}

QWidget *RangeTab::buildOrder()
{
    auto *group = new QGroupBox(QStringLiteral("סדר הפריטים בקטלוג"), this);
    auto *sortBy = named<QComboBox>(QStringLiteral("CmbSortBy"), group);
    auto *sortDir = named<QComboBox>(QStringLiteral("CmbSortDir"), group);
    m_context.binder.choice(
        sortBy, QStringLiteral("SortBy"),
        {QStringLiteral("מפתח פריט"), QStringLiteral("שם פריט"), QStringLiteral("קוד מיון")});
    m_context.binder.choice(sortDir, QStringLiteral("SortDir"),
                            {QStringLiteral("עולה"), QStringLiteral("יורד")});
    auto *layout = new QHBoxLayout(group);
    layout->addWidget(captionFor(QStringLiteral("מיון לפי:"), sortBy, group));
    layout->addWidget(sortBy);
    layout->addWidget(captionFor(QStringLiteral("כיוון:"), sortDir, group));
    layout->addWidget(sortDir);
    layout->addStretch();
    return group;
}

QWidget *RangeTab::buildSelection()
{
    CatalogSettings &settings = m_context.control.settings();
    auto *group = new QGroupBox(QStringLiteral("בחירת פריטים ידנית"), this);
    auto *select =
        named<QPushButton>(QStringLiteral("cmdSelectAccount"), QStringLiteral("בחירת פריטים..."), group);
    auto *useMarked = named<QCheckBox>(QStringLiteral("ChkSelectAccount"),
                                       QStringLiteral("הקטלוג יכלול רק את הפריטים שסומנו"), group);
    m_context.binder.check(useMarked, settings.useMarkedItems);
    useMarked->setToolTip(
        QStringLiteral("כשהתיבה מסומנת, הקטלוג והרשימה נבנים מהפריטים שנאספו וסומנו, בלי לאסוף מחדש"));
    connect(select, &QPushButton::clicked, this, &RangeTab::cmdSelectAccount_Click);
    auto *layout = new QHBoxLayout(group);
    layout->addWidget(select);
    layout->addWidget(useMarked);
    layout->addStretch();
    return group;
}

void RangeTab::cmdSelectAccount_Click()
{
    const RunOutcome prepared = m_context.control.prepareMarking();
    m_context.binder.refresh();
    if (prepared.ending == RunOutcome::Ending::Declined)
        return;
    // Whatever the collection told, the dialog shows what the working database holds.
    frmSelectItem dialog(prepared.file, window());
    dialog.exec();
}

} // namespace zorbin
