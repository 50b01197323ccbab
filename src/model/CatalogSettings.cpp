#include "model/CatalogSettings.h"

#include "platform/Paths.h"

namespace zorbin {

CatalogSettings::CatalogSettings()
    : CmbSortBy({QStringLiteral("מפתח פריט"), QStringLiteral("שם פריט"), QStringLiteral("קוד מיון")}),
      CmbSortDir({QStringLiteral("עולה"), QStringLiteral("יורד")}),
      CmbItemNameType({QStringLiteral("שם סטנדרטי"), QStringLiteral("שם לועזי")}),
      txtPicPath(defaultPictureFolder()), txtPicExtension(QStringLiteral(".JPG")),
      txtRows(QStringLiteral("8")), txtCols(QStringLiteral("3")),
      cmbPicLocation({QStringLiteral("בהתאם לטבלה"), QStringLiteral("מימין לנתונים")}),
      cmbPageSplit({QStringLiteral("קובץ אחד"), QStringLiteral("קובץ לעמוד")}),
      txtTopPercent(QStringLiteral("10")), txtBottomPercent(QStringLiteral("10"))
{
    ItemCutOff.fill(QStringLiteral("*"));
}

std::array<ChoiceList *, 5> CatalogSettings::sourceLists()
{
    return {&cmbPicExtraNote, &cmbExtraNote1, &cmbExtraNote2, &cmbPriceField, &cmbPriceField2};
}

} // namespace zorbin
