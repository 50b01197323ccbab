#pragma once

#include "model/CatalogField.h"

#include <QLabel>
#include <optional>

class QMimeData;

namespace zorbin {

// A label of the cell-line editor: a field of the palette (`LblTitle(i)`) or a line slot
// (`lblLine(i)`). It knows its array and index, so a drop target can tell what was dragged
// onto it. A palette label starts a drag as soon as the mouse button is pressed on it; a slot
// is picked up by a double click.
class FieldLabel : public QLabel
{
    Q_OBJECT

public:
    static inline const QString PaletteArray = QStringLiteral("LblTitle");
    static inline const QString SlotArray = QStringLiteral("lblLine");

    // The label's objectName is "<array>(<index>)", for example "lblLine(2)".
    FieldLabel(const QString &arrayName, int index, QWidget *parent = nullptr);

    const QString &arrayName() const { return m_array; }
    int index() const { return m_index; }

    void setColours(const LabelColours &colours);
    QColor backColour() const;
    QColor foreColour() const;
    // Shows the label as the editor's selected line.
    void setSelected(bool selected);

    // What a drag of a label carries, and which label a dropped payload names (nothing for a
    // payload that is not one of ours).
    struct Dragged
    {
        QString arrayName;
        int index = -1;
    };
    static QMimeData *dragData(const QString &arrayName, int index);
    static std::optional<Dragged> draggedLabel(const QMimeData *data);

Q_SIGNALS:
    void clicked(int index);
    // A label of the editor was dropped on this one.
    void dropped(int index, const zorbin::FieldLabel::Dragged &source);

protected:
    void mousePressEvent(QMouseEvent *event) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;
    void dragEnterEvent(QDragEnterEvent *event) override;
    void dragMoveEvent(QDragMoveEvent *event) override;
    void dropEvent(QDropEvent *event) override;

private:
    void startDrag();

    QString m_array;
    int m_index;
};

} // namespace zorbin
