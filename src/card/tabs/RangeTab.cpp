#include "card/tabs/RangeTab.h"

#include "card/CardContext.h"
#include "card/SettingsBinder.h"
#include "card/tabs/TabBuilding.h"
#include "control/CatalogControl.h"
#include "model/UserPort.h"
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

    auto range = [&](int row, const QString &checkName, const QString &checkCaption, CheckValue &use,
                     const QString &fromName, QString &from, const QString &toName, QString &to,
                     int maxLength) {
        auto *useBox = named<QCheckBox>(checkName, checkCaption, group);
        auto *fromBox = named<QLineEdit>(fromName, group);
        auto *toBox = named<QLineEdit>(toName, group);
        bind.check(useBox, use);
        // Only the upper bound has an entry limit; the lower one takes a key of any length.
        bind.text(fromBox, from);
        bind.text(toBox, to, maxLength);
        fromBox->setAccessibleName(checkCaption);
        tabs::fitToCharacters(fromBox, maxLength, QLatin1Char('0'));
        tabs::fitToCharacters(toBox, maxLength, QLatin1Char('0'));
        grid->addWidget(useBox, row, 0);
        grid->addWidget(fromBox, row, 1);
        grid->addWidget(captionFor(QStringLiteral("עד:"), toBox, group), row, 2);
        grid->addWidget(toBox, row, 3);
    };
    range(0, QStringLiteral("ChkCatCode"), QStringLiteral("מקוד מיון:"), settings.ChkCatCode,
          QStringLiteral("txtFromSort"), settings.txtFromSort, QStringLiteral("txtToSort"),
          settings.txtToSort, MaxLengthSortBound);
    range(1, QStringLiteral("ChkItemKey"), QStringLiteral("מפריט:"), settings.ChkItemKey,
          QStringLiteral("txtFromItem"), settings.txtFromItem, QStringLiteral("txtToItem"),
          settings.txtToItem, MaxLengthItemBound);

    auto *filter = named<QCheckBox>(QStringLiteral("chkFilter"), QStringLiteral("חתך:"), group);
    bind.check(filter, settings.chkFilter);
    filter->setToolTip(QStringLiteral("תו בכל מקום בשדה המיון של הפריט; \"*\" מתאים לכל תו"));
    auto *pattern = new QWidget(group);
    auto *positions = new QHBoxLayout(pattern);
    positions->setContentsMargins(0, 0, 0, 0);
    positions->setSpacing(2);
    for (int position = 1; position <= CutOffPositions; ++position) {
        auto *box = named<QLineEdit>(QStringLiteral("ItemCutOff(%1)").arg(position), pattern);
        bind.text(box, settings.ItemCutOff[static_cast<std::size_t>(position - 1)], MaxLengthCutOff);
        box->setAlignment(Qt::AlignCenter);
        box->setAccessibleName(QStringLiteral("חתך, מקום %1").arg(position));
        tabs::fitToCharacters(box, 1);
        positions->addWidget(box);
    }
    positions->addStretch();
    grid->addWidget(filter, 2, 0);
    grid->addWidget(pattern, 2, 1, 1, 4);
    grid->setColumnStretch(4, 1);
    return group;
}

QWidget *RangeTab::buildOrder()
{
    CatalogSettings &settings = m_context.control.settings();
    auto *group = new QGroupBox(QStringLiteral("סדר הפריטים בקטלוג"), this);
    auto *sortBy = named<QComboBox>(QStringLiteral("CmbSortBy"), group);
    auto *sortDir = named<QComboBox>(QStringLiteral("CmbSortDir"), group);
    m_context.binder.choice(sortBy, settings.CmbSortBy);
    m_context.binder.choice(sortDir, settings.CmbSortDir);
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
    m_context.binder.check(useMarked, settings.ChkSelectAccount);
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
    CatalogControl &control = m_context.control;
    control.settings().ChkSelectAccount = CheckValue::Checked;
    m_context.binder.refresh();

    bool collectAnew = control.runState().WorkDBFile.isEmpty();
    if (!collectAnew) {
        collectAnew =
            control.context().user.ask(QStringLiteral("לסרוק מחדש את רשימת הפריטים?"),
                                       QStringLiteral("שימו לב"), QuestionButtons::YesNo) == Answer::Yes;
    }
    if (collectAnew) {
        // The collection steps report their own failures; one that escaped them is told here,
        // and the dialog then shows whatever the working database holds.
        if (const Status collected = control.collect(); !collected)
            control.context().user.tell(collected.description(), FaultTitle, MessageIcon::Critical);
    }
    frmSelectItem dialog(control.runState().WorkDBFile, window());
    dialog.exec();
}

} // namespace zorbin
