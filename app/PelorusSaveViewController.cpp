#include "app/PelorusSaveViewController.h"

#include "app/CheckMarkDelegate.h"
#include "app/TextLabel.h"
#include "app/content/SaveRows.h"
#include "model/SnapshotFile.h"
#include "ui_PelorusSaveViewController.h"

#include <QShortcut>

namespace pelorus {

namespace {

constexpr int kRowFontSize = 13;

QFont rowFont()
{
    QFont font(QStringLiteral("Helvetica"));
    font.setPixelSize(kRowFontSize);
    return font;
}

} // namespace

PelorusSaveViewController::PelorusSaveViewController(const std::shared_ptr<Array>& contents, Platform& system,
                                                     SaveHost& saveHost)
    : timeStamp(system.now()), saveHistory(contents ? makeArray(contents->elements) : nullptr),
      platform(system), host(saveHost), interface(std::make_unique<Ui::PelorusSaveViewController>())
{
    interface->setupUi(this);
    viewDidLoad();
}

PelorusSaveViewController::~PelorusSaveViewController() = default;

QLineEdit* PelorusSaveViewController::saveDescription() const
{
    return interface->saveDescription;
}

QListWidget* PelorusSaveViewController::saveContentTable() const
{
    return interface->saveContentTable;
}

void PelorusSaveViewController::viewDidLoad()
{
    connect(interface->saveButton, &QPushButton::clicked, this, [this] { savePressed(); });
    connect(interface->cancelButton, &QPushButton::clicked, this, [this] { cancelPressed(); });
    connect(saveDescription(), &QLineEdit::returnPressed, this, [this] { textFieldShouldReturn(); });
    connect(new QShortcut(QKeySequence::Save, this), &QShortcut::activated, this, [this] { savePressed(); });
    connect(new QShortcut(QKeySequence::Cancel, this), &QShortcut::activated, this,
            [this] { cancelPressed(); });

    interface->titleLabel->setFont(systemFont(kCellFontSize + 1, QFont::DemiBold));
    for (QWidget* widget :
         std::initializer_list<QWidget*>{interface->cancelButton, interface->saveButton,
                                         interface->descriptionLabel, interface->contentLabel})
        widget->setFont(systemFont(kStatusFontSize));
    saveDescription()->setFont(systemFont(kCellFontSize));
    saveDescription()->setTextMargins(6, 0, 6, 0);

    QListWidget* table = saveContentTable();
    table->setFont(rowFont());
    table->setItemDelegate(new CheckMarkDelegate(table));
    for (const std::string& text : saveRowTexts(saveHistory)) {
        auto* item = new QListWidgetItem(QString::fromStdString(text), table);
        item->setFlags(Qt::ItemIsEnabled); // every entry is saved: there is nothing to choose
        item->setCheckState(Qt::Checked);
    }
    // Rows are not acted on, but whoever taps one is done with the description.
    connect(table, &QListWidget::itemPressed, this, [this] { didSelectRowAtIndexPath(); });
    table->setSizeAdjustPolicy(QAbstractScrollArea::AdjustToContents);
    table->setVisible(table->count() > 0);
    interface->contentLabel->setText(table->count() > 0 ? tr("What is saved")
                                                        : tr("There is nothing to save yet."));
}

void PelorusSaveViewController::showEvent(QShowEvent* event)
{
    QWidget::showEvent(event);
    saveDescription()->setFocus(Qt::OtherFocusReason);
}

void PelorusSaveViewController::savePressed()
{
    const auto path =
        writeSnapshotFile(platform, snapshotFileContent(dateText(timeStamp), saveHistory,
                                                        saveDescription()->text().toStdString()));
    if (path)
        host.snapshotSaved(*path);
    else
        host.showAlert("File Error", "Unable to write file to disk");
    platform.dispatchAsyncOnMain([app = &host] { app->closeSaveView(); });
}

void PelorusSaveViewController::cancelPressed()
{
    platform.dispatchAsyncOnMain([app = &host] { app->closeSaveView(); });
}

bool PelorusSaveViewController::textFieldShouldReturn()
{
    saveDescription()->clearFocus();
    return true;
}

void PelorusSaveViewController::didSelectRowAtIndexPath()
{
    saveDescription()->clearFocus();
}

void PelorusSaveViewController::backgroundTouched()
{
    saveDescription()->clearFocus();
}

void PelorusSaveViewController::mousePressEvent(QMouseEvent*)
{
    backgroundTouched();
}

} // namespace pelorus
