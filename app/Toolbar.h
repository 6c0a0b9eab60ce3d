#pragma once

#include "app/content/ToolbarItems.h"

#include <QWidget>
#include <functional>

class QToolButton;

namespace pelorus {

class ActivityIndicator;
class ElidedLabel;

/// The bar below the panes. New items take the place of the old ones without a flicker.
class Toolbar : public QWidget {
public:
    Toolbar(std::function<void()> save, QWidget* parent = nullptr);
    void setItems(const ToolbarItems& items);
    /// Stands in for the status until it is empty again; beside it while the indicator runs.
    void setNotice(const QString& text);
    ActivityIndicator& indicator() { return *wheel; }
    QToolButton& saveButton() { return *button; }
    ElidedLabel& statusLabel() { return *label; }

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    void showText();

    ActivityIndicator* wheel;
    ElidedLabel* label;
    QToolButton* button;
    QString status;
    QString notice;
};

} // namespace pelorus
