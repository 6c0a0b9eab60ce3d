#pragma once

#include <QScrollBar>

namespace pelorus {

/// A scroll bar that is only a thumb, so that it does not draw the eye from the rows beside it.
class SlimScrollBar : public QScrollBar {
public:
    using QScrollBar::QScrollBar;
    QSize sizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;
};

} // namespace pelorus
