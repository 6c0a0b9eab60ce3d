#pragma once

#include "app/DateFormatter.h"
#include "app/HomeScreenPreferences.h"
#include "app/NavigationController.h"
#include "app/PaneHost.h"
#include "app/SaveHost.h"
#include "app/Window.h"
#include "model/PelorusModel.h"

#include <memory>

namespace pelorus {

class PelorusSaveViewController;

/// The application object: owns the window, the stack of panes, the model and the save screen, and keeps
/// them together.
class PelorusApp : public PelorusModelObserver,
                   private NavigationDelegate,
                   private PaneHost,
                   private SaveHost {
public:
    PelorusApp(Platform& platform, HomeScreenPreferences& homeScreen, std::string dataDirectory);
    ~PelorusApp() override;

    void applicationDidFinishLaunching();
    void applicationWillTerminate();
    void getSaveButtonPref();
    void _setGSMRSSI(bool shown);

    void updateViewControllerFromModel() override;
    void connectionChanged() override;
    void updateStatusForViewController(PelorusPaneController& pane);
    void showSaveView() override;
    void closeSaveView() override;

    Window* getWindow() const { return window.get(); }
    NavigationController* navigationController() const { return navController; }
    PelorusModel* getModel() const { return model.get(); }
    PelorusSaveViewController* getSaveViewController() const { return saveViewController; }
    const std::string& getUpdateMessage() const { return updateMessage; }
    bool allowSaveButton() const override { return allowsSaveButton; }

private:
    void willShowViewController(PelorusPaneController& pane, bool animated) override;
    void snapshotSaved(const std::string& path) override;
    void showAlert(const std::string& title, const std::string& message) override;

    std::unique_ptr<Window> window;
    NavigationController* navController = nullptr;           // the window's
    PelorusSaveViewController* saveViewController = nullptr; // the window's, while it is shown
    std::unique_ptr<PelorusModel> model;
    bool allowsSaveButton = false;
    std::unique_ptr<DateFormatter> dateFormatter;
    std::string updateMessage;

    Platform& platform;
    HomeScreenPreferences& homeScreen;
    std::string dataDirectory;
    std::shared_ptr<int> notices = std::make_shared<int>(0); // how many were shown; ends with the application
};

} // namespace pelorus
