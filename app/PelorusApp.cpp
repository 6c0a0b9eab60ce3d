#include "app/PelorusApp.h"

#include "app/Accessibility.h"
#include "app/PelorusPaneController.h"
#include "app/PelorusSaveViewController.h"
#include "app/Toolbar.h"
#include "app/content/InternalBuildMarker.h"

#include <QMessageBox>

namespace pelorus {

namespace {

constexpr std::chrono::seconds kNoticeTime{5};

} // namespace

PelorusApp::PelorusApp(Platform& system, HomeScreenPreferences& preferences, std::string data)
    : platform(system), homeScreen(preferences), dataDirectory(std::move(data))
{}

PelorusApp::~PelorusApp() = default;

void PelorusApp::applicationDidFinishLaunching()
{
    installAccessibility();
    getSaveButtonPref();
    window = std::make_unique<Window>();
    model = std::make_unique<PelorusModel>(platform, *this);
    updateMessage = "Connecting...";
    dateFormatter = std::make_unique<DateFormatter>(QStringLiteral("'Updated' yyyy-MM-dd 'at' HH:mm:ss"));

    auto* root = new PelorusPaneController(nullptr, "/", *this);
    root->setStatus("Connecting", true); // no dots yet: meant
    navController = new NavigationController(root);
    navController->setDelegate(this);
    window->setRootView(*navController);
    window->restorePlace();
    window->show();
    platform.dispatchAsyncOnMain([this, alive = std::weak_ptr<int>(notices)] {
        if (!alive.expired() && model)
            model->restartMonitor();
    });
}

void PelorusApp::applicationWillTerminate()
{
    _setGSMRSSI(false); // whoever switched it on: this program leaves it off
    updateMessage.clear();
    dateFormatter.reset();
    saveViewController = nullptr;
    navController = nullptr;
    if (window)
        window->close();
    window.reset();
    model.reset();
}

void PelorusApp::getSaveButtonPref()
{
    allowsSaveButton = isInternalBuild(platform, dataDirectory);
}

void PelorusApp::_setGSMRSSI(bool shown)
{
    homeScreen.setBoolean("HBShowGSMRSSI", shown);
}

void PelorusApp::updateViewControllerFromModel()
{
    if (!navController)
        return;
    const std::vector<PelorusPaneController*> panes = navController->viewControllers();
    panes.front()->reloadWithNode(model->topLevelNodes());
    for (std::size_t index = 1; index < panes.size(); ++index) {
        auto node = model->nodeAtPath(panes[index]->path());
        if (!node) {
            navController->popToViewController(index - 1, true);
            break;
        }
        panes[index]->reloadWithNode(std::move(node));
    }
    if (model->isConnected())
        updateMessage = dateFormatter->stringFromDate(platform.now());
    updateStatusForViewController(*navController->topViewController());
}

void PelorusApp::connectionChanged()
{
    if (navController)
        updateStatusForViewController(*navController->topViewController());
}

void PelorusApp::updateStatusForViewController(PelorusPaneController& pane)
{
    if (model->isConnected())
        pane.setStatus(updateMessage, false);
    else
        pane.setStatus("Connecting...", true);
}

void PelorusApp::willShowViewController(PelorusPaneController& pane, bool)
{
    updateStatusForViewController(pane);
}

void PelorusApp::showSaveView()
{
    if (saveViewController)
        return;
    saveViewController = new PelorusSaveViewController(model->getSaveContents(), platform, *this);
    window->present(*saveViewController, true);
}

void PelorusApp::closeSaveView()
{
    if (!saveViewController)
        return;
    window->dismiss(*std::exchange(saveViewController, nullptr), true);
    navController->topViewController()->setFocus(Qt::OtherFocusReason);
}

void PelorusApp::snapshotSaved(const std::string& path)
{
    const std::string name = path.substr(path.rfind('/') + 1);
    navController->toolbar().setNotice(QString::fromStdString("Saved " + name));
    const int number = ++*notices;
    platform.dispatchAfterOnMain(kNoticeTime, [this, number, shown = std::weak_ptr<int>(notices)] {
        const auto last = shown.lock();
        if (last && *last == number && navController) // a newer notice has its own time
            navController->toolbar().setNotice({});
    });
}

void PelorusApp::showAlert(const std::string& title, const std::string& message)
{
    auto* alert = new QMessageBox(QMessageBox::Warning, QString::fromStdString(title),
                                  QString::fromStdString(message), QMessageBox::NoButton, window.get());
    alert->addButton(QStringLiteral("Close"), QMessageBox::RejectRole);
    alert->setAttribute(Qt::WA_DeleteOnClose);
    alert->open();
}

} // namespace pelorus
