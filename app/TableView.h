#pragma once

#include "app/PelorusCell.h"

#include <QAbstractScrollArea>
#include <QBasicTimer>
#include <string>
#include <unordered_map>
#include <vector>

class QScrollEvent;
class QScrollPrepareEvent;
class QTouchEvent;

namespace pelorus {

class TableView;

/// Says what a table shows. Rows are counted from 0.
class TableSource {
public:
    virtual ~TableSource() = default;
    virtual int numberOfRowsInSection() const = 0;
    /// A cell from the table's dequeueReusableCell(), or a new one that is a child of the table's viewport,
    /// with texts and layout.
    virtual PelorusCell& cellForRowAtIndexPath(TableView& table, int row, const QSize& size) = 0;
    /// By what a row is found again when others come and go around it.
    virtual const std::string& identityOfRow(int row) const = 0;
    virtual std::optional<int> rowWithIdentity(const std::string& identity) const = 0;
    virtual QString nameOfRow(int row) const = 0;
    virtual QString valueOfRow(int row) const = 0;
    virtual void didSelectRowAtIndexPath(int row) = 0;
    virtual void showMenuForRow(int row, const QPoint& globalPosition) = 0;
};

/// A table that has cells only for the rows in sight. Neither a reload nor a resize moves what the user looks
/// at: the uppermost row in sight that is still there keeps its place, the chosen row stays chosen, and each
/// strip keeps its offset.
class TableView : public QAbstractScrollArea {
public:
    explicit TableView(TableSource& source, QWidget* parent = nullptr);

    void reloadData();
    /// A cell that no row needs any more, the one that the row in work had before if it can be.
    PelorusCell* dequeueReusableCell(const QString& reuseIdentifier, bool leaf);
    void deselectRow();

    int rowCount() const { return rows; }
    /// Nothing when there is no row there.
    std::optional<int> rowAt(const QPoint& viewportPosition) const;
    QRect rectOfRow(int row) const; // in the viewport, perhaps outside
    /// Null when the row is out of sight.
    PelorusCell* cellOfRow(int row) const;
    /// Where the keyboard is; the row is shown as chosen only while hasHighlight().
    std::optional<int> currentRow() const { return current; }
    bool hasHighlight() const { return highlighted; }
    void setCurrentRow(int row);
    void scrollToRow(int row);
    const TableSource& tableSource() const { return source; }
    void activateRow(int row);
    void openMenu(int row, const QPoint& globalPosition);

protected:
    bool viewportEvent(QEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void scrollContentsBy(int dx, int dy) override;
    void keyPressEvent(QKeyEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void timerEvent(QTimerEvent* event) override;

private:
    struct Shown {
        PelorusCell* cell = nullptr;
        int row = 0;
        std::string identity;
    };

    void updateRange();
    void layOutCells();
    void show(int row);
    int top() const;
    void setOffsetOfRow(int row, double offset);
    double offsetOfRow(int row) const;

    void acceptTouch();
    void touch(QTouchEvent& event);
    void forgetPress();
    void prepareFlick(QScrollPrepareEvent& event);
    void flick(const QPointF& position);
    void moveCurrent(int row);

    TableSource& source;
    int rows = 0;
    std::vector<Shown> shown; // in the order of rows, without gaps
    std::vector<Shown> reusable;
    std::string rowInWork;                           // identity of the row that a cell is asked for
    std::unordered_map<std::string, double> offsets; // of strips that are scrolled, by identity
    std::optional<int> current;
    std::string currentIdentity;
    bool highlighted = false;

    struct Press {
        std::string identity;
        QPoint where;
        double offset = 0;
        bool drags = false;
        bool held = false;
    };
    std::optional<Press> press;
    QBasicTimer holdTimer; // runs while a finger is held still
    std::string flicked;   // identity of the row that a finger was put on
};

} // namespace pelorus
