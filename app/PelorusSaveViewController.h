#pragma once

#include "app/SaveHost.h"
#include "platform/Platform.h"

#include <QWidget>

class QLineEdit;
class QListWidget;

namespace Ui {
class PelorusSaveViewController;
}

namespace pelorus {

/// The screen that lists what a snapshot holds, takes a description and writes the file. Its layout is the
/// interface file of the same name.
class PelorusSaveViewController : public QWidget {
public:
    /// Later snapshots do not change what is saved. `contents` may be null.
    PelorusSaveViewController(const std::shared_ptr<Array>& contents, Platform& platform, SaveHost& host);
    ~PelorusSaveViewController() override;

    QLineEdit* saveDescription() const;
    QListWidget* saveContentTable() const;

    void savePressed();
    void cancelPressed();
    /// Return only closes the keyboard.
    bool textFieldShouldReturn();
    void didSelectRowAtIndexPath();
    void backgroundTouched();

protected:
    void mousePressEvent(QMouseEvent* event) override;
    void showEvent(QShowEvent* event) override;

private:
    void viewDidLoad();

    std::chrono::system_clock::time_point timeStamp;
    std::shared_ptr<Array> saveHistory;

    Platform& platform;
    SaveHost& host;
    std::unique_ptr<Ui::PelorusSaveViewController> interface;
};

} // namespace pelorus
