#pragma once

#include "app/PaneHost.h"
#include "app/TableView.h"
#include "app/content/PaneRows.h"
#include "app/content/ToolbarItems.h"

namespace pelorus {

class NavigationController;

/// One level of the display tree: a table with a row per child of its node. Its path never changes, its node
/// is replaced at every refresh.
class PelorusPaneController : public QWidget, private TableSource {
public:
    PelorusPaneController(std::shared_ptr<const PelorusModelNode> node, std::string path, PaneHost& host);

    const std::string& path() const { return keyPath; }
    QString title() const;
    const ToolbarItems& toolbarItems() const { return items; }
    TableView& tableView() { return *table; }
    /// The stack that the pane is on; it sets this itself.
    void setNavigationController(NavigationController* controller) { navigationController = controller; }

    void viewWillAppear();
    void viewWillDisappear();
    void setStatus(const std::string& text, bool loading);
    void reloadWithNode(std::shared_ptr<const PelorusModelNode> node);
    void createToolbarItems();
    /// What the Save button does.
    void savePressed() { host.showSaveView(); }

    int numberOfRowsInSection() const override { return rows.count(); }
    PelorusCell& cellForRowAtIndexPath(TableView& table, int row, const QSize& size) override;
    void didSelectRowAtIndexPath(int row) override;

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    const std::string& identityOfRow(int row) const override { return rows.identityOf(row); }
    std::optional<int> rowWithIdentity(const std::string& identity) const override
    {
        return rows.find(identity);
    }
    QString nameOfRow(int row) const override;
    QString valueOfRow(int row) const override;
    void showMenuForRow(int row, const QPoint& globalPosition) override;
    void showTitle();

    std::shared_ptr<const PelorusModelNode> nodes;
    std::string keyPath;
    std::string status;
    bool isLoading = true;

    PaneHost& host;
    NavigationController* navigationController = nullptr;
    PaneRows rows;
    ToolbarItems items;
    TableView* table;
};

} // namespace pelorus
