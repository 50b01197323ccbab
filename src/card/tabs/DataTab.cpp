#include "card/tabs/DataTab.h"

#include "card/CardContext.h"
#include "card/FolderField.h"
#include "card/SettingsBinder.h"
#include "card/tabs/TabBuilding.h"
#include "control/CatalogControl.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QRadioButton>
#include <QVBoxLayout>

namespace zorbin {

using tabs::captionFor;
using tabs::named;

namespace {

// A list filled from the accounting database: wide enough for its longer names, and saying so
// when no entry is selected (an accounting database that could not be reached leaves it empty).
void showSourceList(QComboBox *list, const QString &caption)
{
    list->setAccessibleName(QString(caption).remove(QLatin1Char(':')));
    list->setSizeAdjustPolicy(QComboBox::AdjustToContents);
    list->setMinimumContentsLength(18);
    list->setPlaceholderText(QStringLiteral("(לא נבחר)"));
}

// A check box that switches a choice on, and the list to choose from.
void addSwitchedChoice(QGridLayout *grid, int row, SettingsBinder &bind, const QString &checkName,
                       const QString &caption, const QString &useKey, const QString &listName,
                       ChoiceList &list)
{
    QWidget *parent = grid->parentWidget();
    auto *useBox = named<QCheckBox>(checkName, caption, parent);
    auto *choice = named<QComboBox>(listName, parent);
    bind.check(useBox, useKey);
    bind.choice(choice, list);
    showSourceList(choice, caption);
    grid->addWidget(useBox, row, 0);
    grid->addWidget(choice, row, 1);
}

} // namespace

DataTab::DataTab(CardContext &context, QWidget *parent) : QWidget(parent), m_context(context)
{
    setObjectName(QStringLiteral("DataTab"));
    auto *layout = new QVBoxLayout(this);
    layout->addWidget(buildNames());
    layout->addWidget(buildPrices());
    layout->addWidget(buildNotes());
    layout->addWidget(buildPictures());
    layout->addStretch();
}

QWidget *DataTab::buildNames()
{
    auto *group = new QGroupBox(QStringLiteral("שם הפריט"), this);
    auto *source = named<QComboBox>(QStringLiteral("CmbItemNameType"), group);
    m_context.binder.choice(source, QStringLiteral("ItemNameType"),
                            {QStringLiteral("שם סטנדרטי"), QStringLiteral("שם לועזי")});
    auto *layout = new QHBoxLayout(group);
    layout->addWidget(captionFor(QStringLiteral("השם שיוצג:"), source, group));
    layout->addWidget(source);
    layout->addStretch();
    return group;
}

QWidget *DataTab::buildPrices()
{
    CatalogSettings &settings = m_context.control.settings();
    auto *group = new QGroupBox(QStringLiteral("מחירונים"), this);
    auto *grid = new QGridLayout(group);
    addSwitchedChoice(grid, 0, m_context.binder, QStringLiteral("chkUsePriceField"),
                      QStringLiteral("מחיר 1:"), QStringLiteral("UsePriceField"),
                      QStringLiteral("cmbPriceField"), settings.priceList1);
    addSwitchedChoice(grid, 1, m_context.binder, QStringLiteral("ChkUsePriceField2"),
                      QStringLiteral("מחיר 2:"), QStringLiteral("UsePriceField2"),
                      QStringLiteral("cmbPriceField2"), settings.priceList2);
    grid->setColumnStretch(2, 1);
    return group;
}

QWidget *DataTab::buildNotes()
{
    CatalogSettings &settings = m_context.control.settings();
    auto *group = new QGroupBox(QStringLiteral("נתונים נוספים"), this);
    auto *grid = new QGridLayout(group);
    addSwitchedChoice(grid, 0, m_context.binder, QStringLiteral("ChkUseExtraNote1"),
                      QStringLiteral("נתון נוסף 1:"), QStringLiteral("UseExtraNote1"),
                      QStringLiteral("cmbExtraNote1"), settings.extraNote1);
    addSwitchedChoice(grid, 1, m_context.binder, QStringLiteral("ChkUseExtraNote2"),
                      QStringLiteral("נתון נוסף 2:"), QStringLiteral("UseExtraNote2"),
                      QStringLiteral("cmbExtraNote2"), settings.extraNote2);
    grid->setColumnStretch(2, 1);
    return group;
}

QWidget *DataTab::buildPictures()
{
    CatalogSettings &settings = m_context.control.settings();
    SettingsBinder &bind = m_context.binder;
    auto *group = new QGroupBox(QStringLiteral("מקור התמונה"), this);
    const QStringList captions = {QStringLiteral("מתוך שדה 'קובץ'"), QStringLiteral("על בסיס מפתח פריט:"),
                                  QStringLiteral("מתוך נתון נוסף:")};
    std::vector<QRadioButton *> options;
    for (int i = 0; i < captions.size(); ++i)
        options.push_back(
            named<QRadioButton>(QStringLiteral("OptPicSource(%1)").arg(i), captions.at(i), group));
    bind.options(options,
                 {QStringLiteral("PicSource0"), QStringLiteral("PicSource1"), QStringLiteral("PicSource2")});

    auto *folder = named<QLineEdit>(QStringLiteral("txtPicPath"), group);
    auto *extension = named<QLineEdit>(QStringLiteral("txtPicExtension"), group);
    auto *note = named<QComboBox>(QStringLiteral("cmbPicExtraNote"), group);
    bind.text(folder, QStringLiteral("PicPath"));
    bind.text(extension, QStringLiteral("PicExtension"));
    bind.choice(note, settings.pictureNote);
    tabs::fitToCharacters(extension, 5);
    tabs::showLeftToRight(folder);
    tabs::showLeftToRight(extension);
    showSourceList(note, captions.at(2));
    auto *folderField = new FolderField(folder, QStringLiteral("cmdPicPath"),
                                        QStringLiteral("בחירת מחיצת התמונות"), true, m_context, group);

    auto *grid = new QGridLayout(group);
    grid->addWidget(options[0], 0, 0, 1, 4);
    grid->addWidget(options[1], 1, 0, 1, 4);
    tabs::addFieldRow(grid, 2, QStringLiteral("מחיצת תמונות:"), folder, folderField, {}, 1);
    // A left-to-right box is put beside its caption in absolute terms.
    tabs::addFieldRow(grid, 3, QStringLiteral("סיומת:"), extension, nullptr,
                      Qt::AlignRight | Qt::AlignAbsolute, 1);
    grid->addWidget(options[2], 4, 0, 1, 4);
    grid->addWidget(note, 5, 2, Qt::AlignLeading);
    grid->setColumnMinimumWidth(0, 16);
    grid->setColumnStretch(2, 1);
    return group;
}

} // namespace zorbin
