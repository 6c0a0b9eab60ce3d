#pragma once

#include <QWidget>
#include <vector>

namespace pelorus {

class PelorusPaneController;
class TitleBar;
class Toolbar;

class NavigationDelegate {
public:
    virtual ~NavigationDelegate() = default;
    virtual void willShowViewController(PelorusPaneController& pane, bool animated) = 0;
};

/// A stack of panes of which the top one is seen, between a title bar with the way back and the toolbar with
/// the pane's items. Panes slide in and out, but the stack changes at once.
class NavigationController : public QWidget {
public:
    explicit NavigationController(PelorusPaneController* root, QWidget* parent = nullptr);
    void setDelegate(NavigationDelegate* chosen) { delegate = chosen; }

    const std::vector<PelorusPaneController*>& viewControllers() const { return stack; }
    PelorusPaneController* topViewController() const { return stack.back(); }
    void pushViewController(PelorusPaneController* pane, bool animated);
    void popViewController(bool animated);
    /// The panes above it are gone.
    void popToViewController(std::size_t index, bool animated);

    void titleChanged(const PelorusPaneController& pane);
    void toolbarItemsChanged(const PelorusPaneController& pane);
    TitleBar& titleBar() { return *title; }
    Toolbar& toolbar() { return *tools; }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;

private:
    enum class Way { in, out };
    void adopt(PelorusPaneController& pane);
    void willShow(PelorusPaneController& pane, bool animated);
    void slide(PelorusPaneController* from, PelorusPaneController* to, Way way, bool animated);
    void fillRoom();
    void showBars();

    NavigationDelegate* delegate = nullptr;
    std::vector<PelorusPaneController*> stack;
    TitleBar* title;
    QWidget* room; // where the panes are
    Toolbar* tools;
    bool appeared = false;
    int slides = 0; // that run now
};

} // namespace pelorus
