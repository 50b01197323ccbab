#include "model/CatalogSettings.h"

#include "model/OptionTable.h"

namespace zorbin {

CatalogSettings::CatalogSettings()
{
    cutOff.fill(QStringLiteral("*"));
    for (const auto *table : {&catalogOptionTable(), &cellFormatTable()}) {
        for (const StoredOption &option : *table)
            option.apply(*this, option.defaultText);
    }
}

std::array<ChoiceList *, 5> CatalogSettings::sourceLists()
{
    return {&pictureNote, &extraNote1, &extraNote2, &priceList1, &priceList2};
}

} // namespace zorbin
