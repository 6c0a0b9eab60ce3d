#pragma once

#include <QBasicTimer>
#include <QWidget>

namespace pelorus {

/// A small grey wheel that turns while something is going on, and hides when it is not.
class ActivityIndicator : public QWidget {
public:
    explicit ActivityIndicator(QWidget* parent = nullptr);
    void setRunning(bool running);
    bool isRunning() const { return running; }
    QSize sizeHint() const override { return {20, 20}; }

protected:
    void paintEvent(QPaintEvent* event) override;
    void timerEvent(QTimerEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;

private:
    bool running = false;
    int step = 0;
    QBasicTimer timer; // runs while the wheel can be seen
};

} // namespace pelorus
