#pragma once

#include <QWidget>

namespace pelorus {

/// The single window. It shows one view, and above it a sheet while one is presented; it remembers its place
/// on the screen from one run to the next.
class Window : public QWidget {
public:
    Window();
    void setRootView(QWidget& view);
    /// The sheet covers the view, which gets no input until it is dismissed.
    void present(QWidget& sheet, bool animated);
    /// Deletes the sheet in the end.
    void dismiss(QWidget& sheet, bool animated);
    void restorePlace();

protected:
    void resizeEvent(QResizeEvent* event) override;
    void closeEvent(QCloseEvent* event) override;

private:
    QWidget* root = nullptr;
    QWidget* presented = nullptr;
};

} // namespace pelorus
