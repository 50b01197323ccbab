#pragma once

#include "common/Status.h"

#include <QString>
#include <optional>

namespace zorbin {

struct CatalogSettings;

// The numbers of the settings page that the catalog pages depend on. They are kept as the text
// the user typed; these checks tell the user which field to mend before a run starts, instead
// of a failure deep inside the run.
enum class NumericSetting {
    Rows,          // txtRows: a whole number from 1 to 999
    Cols,          // txtCols: a whole number from 1 to 999
    TopPercent,    // txtTopPercent: 0 to 99, or empty (as 0) for no top band, as earlier versions read it
    BottomPercent, // txtBottomPercent: 0 to 99, or empty for no bottom band
    ImageH,        // txtImageH: 0 to 999, or empty for no largest size
    ImageW,        // txtImageW: 0 to 999, or empty for no largest size
};

// What is wrong with a typed value, in a sentence that names the field and its tab and says
// what to type; nothing when the value is acceptable. A fraction counts as its whole number
// rounded half to even, as the runs read it.
std::optional<QString> numericSettingProblem(NumericSetting setting, const QString &text);

// The first problem among the numbers of the settings, as a fault; success when there is none.
Status validateNumericSettings(const CatalogSettings &settings);

} // namespace zorbin
