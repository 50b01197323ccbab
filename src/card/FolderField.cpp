#include "card/FolderField.h"

#include "card/CardContext.h"
#include "card/FileChooser.h"
#include "platform/Paths.h"

#include <QHBoxLayout>
#include <QLineEdit>
#include <QStyle>
#include <QToolButton>

namespace zorbin {

FolderField::FolderField(QLineEdit *box, const QString &buttonName, const QString &dialogTitle,
                         bool trailingSeparator, CardContext &context, QWidget *parent)
    : QWidget(parent), m_box(box), m_button(new QToolButton(this)), m_title(dialogTitle),
      m_trailingSeparator(trailingSeparator), m_context(context)
{
    m_button->setObjectName(buttonName);
    m_button->setText(QStringLiteral("עיון..."));
    m_button->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    m_button->setIcon(style()->standardIcon(QStyle::SP_DirOpenIcon));
    m_button->setToolTip(dialogTitle);
    connect(m_button, &QToolButton::clicked, this, &FolderField::chooseFolder);

    auto *layout = new QHBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(box, 1);
    layout->addWidget(m_button);
}

void FolderField::chooseFolder()
{
    const auto chosen = m_context.files->chooseFolder(window(), m_title, m_box->text());
    if (!chosen)
        return;
    m_box->setText(m_trailingSeparator ? withTrailingSeparator(*chosen) : *chosen);
}

} // namespace zorbin
