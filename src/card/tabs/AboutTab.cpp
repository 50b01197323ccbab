#include "card/tabs/AboutTab.h"

#include <QLabel>
#include <QVBoxLayout>

namespace zorbin {

AboutTab::AboutTab(QWidget *parent) : QWidget(parent)
{
    setObjectName(QStringLiteral("AboutTab"));
    auto *name = new QLabel(QStringLiteral("זורבין"), this);
    name->setObjectName(QStringLiteral("lblProductName"));
    QFont large = name->font();
    large.setPointSizeF(large.pointSizeF() * 1.8);
    large.setBold(true);
    name->setFont(large);

    auto *version = new QLabel(QStringLiteral("גרסה %1").arg(QStringLiteral(ZORBIN_VERSION)), this);
    version->setObjectName(QStringLiteral("lblVersion"));

    auto *description = new QLabel(
        QStringLiteral("הפקת קטלוג מוצרים מנתוני הפריטים של ויזקאונט: דפי HTML בעברית, מימין לשמאל, "
                       "עם תמונות, מחירים ונתונים נוספים, מוכנים לפרסום או להדפסה."),
        this);
    description->setWordWrap(true);

    auto *steps = new QLabel(
        QStringLiteral(
            "1. בלשונית \"כללי\": הגדרות ההתחברות לויזקאונט ומחיצת היעד.\n"
            "2. בלשוניות \"טווח הפריטים\" ו\"הגדרות נתונים\": אילו פריטים ואילו נתונים.\n"
            "3. בלשוניות \"הגדרת עמוד בקטלוג\" ו\"כותרות לעמוד\": מראה העמוד.\n"
            "4. \"הצג קטלוג\" מכין את הקטלוג ופותח אותו בדפדפן; \"שמור הגדרות\" שומר את ההגדרות לפעם הבאה."),
        this);
    steps->setWordWrap(true);

    auto *maker = new QLabel(QStringLiteral("© טרניק מערכות מידע"), this);
    maker->setObjectName(QStringLiteral("lblMaker"));

    auto *layout = new QVBoxLayout(this);
    layout->setSpacing(10);
    layout->addWidget(name);
    layout->addWidget(version);
    layout->addWidget(description);
    layout->addWidget(steps);
    layout->addWidget(maker);
    layout->addStretch();
}

} // namespace zorbin
