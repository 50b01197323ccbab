#pragma once

#include <QWidget>

namespace zorbin {

// The progress bar of the control: an outline (`ProgressFrame`) whose width is the full scale,
// and a fill (`ProgressFill`) whose width in pixels shows the current step's progress.
class ProgressStrip : public QWidget
{
    Q_OBJECT

public:
    explicit ProgressStrip(QWidget *parent = nullptr);

    int frameWidth() const;
    int fillWidth() const { return m_fill; }
    void setFillWidth(int width);

    QSize sizeHint() const override;

protected:
    void paintEvent(QPaintEvent *event) override;

private:
    int m_fill = 0;
};

} // namespace zorbin
