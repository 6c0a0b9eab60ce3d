#pragma once

#include <QLabel>

namespace pelorus {

/// A line of text that ends in an ellipsis where there is no room for all of it.
class ElidedLabel : public QLabel {
public:
    explicit ElidedLabel(QWidget* parent = nullptr);
    QSize minimumSizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;
};

} // namespace pelorus
