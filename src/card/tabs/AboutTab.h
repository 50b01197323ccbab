#pragma once

#include <QWidget>

namespace zorbin {

// The about tab ("אודות"): what the program is, its version and maker.
class AboutTab : public QWidget
{
    Q_OBJECT

public:
    explicit AboutTab(QWidget *parent = nullptr);
};

} // namespace zorbin
