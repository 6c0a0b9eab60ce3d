#pragma once

#include <QWidget>
#include <functional>
#include <optional>

class QToolButton;

namespace pelorus {

class ElidedLabel;

/// The bar above the panes: the title in its middle, the way back on its left.
class TitleBar : public QWidget {
public:
    TitleBar(std::function<void()> back, QWidget* parent = nullptr);
    void setTitle(const QString& title);
    /// What the way back leads to; nothing where there is none.
    void setBackTitle(const std::optional<QString>& title);
    QToolButton& backButton() { return *button; }
    QString title() const;

protected:
    void resizeEvent(QResizeEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void changeEvent(QEvent* event) override;

private:
    void arrange();
    void drawArrow();

    QToolButton* button;
    ElidedLabel* label;
    std::optional<QString> backTitle;
};

} // namespace pelorus
