#include "card/FieldLabel.h"

#include <QApplication>
#include <QDrag>
#include <QDragEnterEvent>
#include <QMimeData>
#include <QMouseEvent>

namespace zorbin {
namespace {

const QString MimeType = QStringLiteral("application/x-zorbin-cell-label");

QColor toColour(const Rgb &rgb)
{
    return QColor(rgb.red, rgb.green, rgb.blue);
}

} // namespace

FieldLabel::FieldLabel(const QString &arrayName, int index, QWidget *parent)
    : QLabel(parent), m_array(arrayName), m_index(index)
{
    setObjectName(QStringLiteral("%1(%2)").arg(arrayName).arg(index));
    setAutoFillBackground(true);
    setAcceptDrops(true);
    setAlignment(Qt::AlignCenter);
    setFrameShape(QFrame::Panel);
    setFrameShadow(QFrame::Sunken);
    setMinimumWidth(fontMetrics().horizontalAdvance(QStringLiteral("נתון נוסף 1")) + 24);
    setMinimumHeight(fontMetrics().height() + 8);
    setCursor(arrayName == PaletteArray ? Qt::OpenHandCursor : Qt::PointingHandCursor);
}

void FieldLabel::setColours(const LabelColours &colours)
{
    QPalette shown = parentWidget() ? parentWidget()->palette() : QApplication::palette();
    shown.setColor(QPalette::Window, toColour(colours.back));
    if (colours.fore)
        shown.setColor(QPalette::WindowText, toColour(*colours.fore));
    setPalette(shown);
}

QColor FieldLabel::backColour() const
{
    return palette().color(QPalette::Window);
}

QColor FieldLabel::foreColour() const
{
    return palette().color(QPalette::WindowText);
}

void FieldLabel::setSelected(bool selected)
{
    setFrameShadow(selected ? QFrame::Raised : QFrame::Sunken);
    setLineWidth(selected ? 2 : 1);
    QFont shown = font();
    shown.setBold(selected);
    setFont(shown);
}

QMimeData *FieldLabel::dragData(const QString &arrayName, int index)
{
    auto *data = new QMimeData;
    data->setData(MimeType, QStringLiteral("%1 %2").arg(arrayName).arg(index).toUtf8());
    return data;
}

std::optional<FieldLabel::Dragged> FieldLabel::draggedLabel(const QMimeData *data)
{
    if (!data || !data->hasFormat(MimeType))
        return std::nullopt;
    const QStringList parts = QString::fromUtf8(data->data(MimeType)).split(QLatin1Char(' '));
    if (parts.size() != 2)
        return std::nullopt;
    bool isNumber = false;
    const int index = parts.at(1).toInt(&isNumber);
    if (!isNumber)
        return std::nullopt;
    return Dragged{parts.at(0), index};
}

void FieldLabel::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton) {
        QLabel::mousePressEvent(event);
        return;
    }
    if (m_array == PaletteArray)
        startDrag();
    else
        Q_EMIT clicked(m_index);
}

void FieldLabel::mouseDoubleClickEvent(QMouseEvent *event)
{
    if (event->button() == Qt::LeftButton && m_array == SlotArray)
        startDrag();
    else
        QLabel::mouseDoubleClickEvent(event);
}

void FieldLabel::startDrag()
{
    auto *drag = new QDrag(this);
    drag->setMimeData(dragData(m_array, m_index));
    // The dragged picture is the label itself, so the user sees what is being carried.
    const QPixmap picture = grab();
    drag->setPixmap(picture);
    drag->setHotSpot(QPoint(picture.width() / 2, picture.height() / 2));
    drag->exec(Qt::MoveAction | Qt::CopyAction, Qt::MoveAction);
}

void FieldLabel::dragEnterEvent(QDragEnterEvent *event)
{
    if (draggedLabel(event->mimeData()))
        event->acceptProposedAction();
}

void FieldLabel::dragMoveEvent(QDragMoveEvent *event)
{
    if (draggedLabel(event->mimeData()))
        event->acceptProposedAction();
}

void FieldLabel::dropEvent(QDropEvent *event)
{
    const auto source = draggedLabel(event->mimeData());
    if (!source)
        return;
    event->acceptProposedAction();
    Q_EMIT dropped(m_index, *source);
}

} // namespace zorbin
