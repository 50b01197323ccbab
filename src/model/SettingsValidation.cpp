#include "model/SettingsValidation.h"

#include "common/Numbers.h"
#include "model/CatalogSettings.h"

#include <array>

namespace zorbin {
namespace {

struct NumberRule
{
    QString field; // the caption the user sees beside the box
    QString tab;
    int lowest;
    int highest;
    bool mayBeEmpty;
};

NumberRule ruleOf(NumericSetting setting)
{
    const QString pageTab = QStringLiteral("הגדרת עמוד בקטלוג");
    const QString titlesTab = QStringLiteral("כותרות לעמוד");
    switch (setting) {
    case NumericSetting::Rows:
        return {QStringLiteral("שורות"), pageTab, 1, 999, false};
    case NumericSetting::Cols:
        return {QStringLiteral("עמודות"), pageTab, 1, 999, false};
    case NumericSetting::TopPercent:
        return {QStringLiteral("גובה הכותרת העליונה"), titlesTab, 0, 99, true};
    case NumericSetting::BottomPercent:
        return {QStringLiteral("גובה הכותרת התחתונה"), titlesTab, 0, 99, true};
    case NumericSetting::ImageH:
        return {QStringLiteral("גובה מקסימלי לתמונה"), pageTab, 0, 999, true};
    case NumericSetting::ImageW:
        return {QStringLiteral("רוחב מקסימלי לתמונה"), pageTab, 0, 999, true};
    }
    Q_UNREACHABLE();
}

} // namespace

std::optional<QString> numericSettingProblem(NumericSetting setting, const QString &text)
{
    const NumberRule rule = ruleOf(setting);
    if (rule.mayBeEmpty && text.trimmed().isEmpty())
        return std::nullopt;
    if (toWholeNumber(text, rule.lowest, rule.highest))
        return std::nullopt;
    QString wanted = QStringLiteral("יש להזין מספר שלם מ-%1 עד %2").arg(rule.lowest).arg(rule.highest);
    if (rule.mayBeEmpty)
        wanted += QStringLiteral(", או להשאיר את השדה ריק");
    if (text.trimmed().isEmpty())
        return QStringLiteral("השדה \"%1\" בלשונית \"%2\" ריק: %3.").arg(rule.field, rule.tab, wanted);
    return QStringLiteral("הערך \"%1\" בשדה \"%2\" בלשונית \"%3\" אינו תקין: %4.")
        .arg(text, rule.field, rule.tab, wanted);
}

Status validateNumericSettings(const CatalogSettings &settings)
{
    const std::array<std::pair<NumericSetting, const QString *>, 6> fields = {{
        {NumericSetting::Rows, &settings.txtRows},
        {NumericSetting::Cols, &settings.txtCols},
        {NumericSetting::ImageH, &settings.txtImageH},
        {NumericSetting::ImageW, &settings.txtImageW},
        {NumericSetting::TopPercent, &settings.txtTopPercent},
        {NumericSetting::BottomPercent, &settings.txtBottomPercent},
    }};
    for (const auto &[setting, text] : fields) {
        if (const auto problem = numericSettingProblem(setting, *text))
            return Status::fault(*problem);
    }
    return Status::ok();
}

} // namespace zorbin
