#pragma once

#include "app/TextLabel.h"

#include <QWidget>
#include <optional>

namespace pelorus {

/// One row of a pane: an inner node's name, or a leaf's name and value in a strip that scrolls horizontally
/// where the two do not fit. A cell is used for one row after the other, but stays of the kind that it was
/// made as.
class PelorusCell : public QWidget {
public:
    enum class Accessory { none, disclosureIndicator };
    struct ScrollView {
        QRectF frame;
        QSizeF contentSize;
        double offset = 0; // of what is shown, from the content's left
    };

    /// For an inner node.
    static PelorusCell* initWithStyleKey(const QString& reuseIdentifier, QWidget* parent);
    /// For a leaf.
    static PelorusCell* initWithStyle(const QString& reuseIdentifier, QWidget* parent);

    const QString& reuseIdentifier() const { return identifier; }
    bool isLeaf() const { return view.has_value(); }

    const TextLabel& key() const { return keyLabel; }
    void setKey(const QString& text);
    /// Null when the row is an inner node's.
    const TextLabel* value() const { return valueLabel ? &*valueLabel : nullptr; }
    void setValue(const QString& text);
    const ScrollView* scrollView() const { return view ? &*view : nullptr; }
    void setAccessory(Accessory accessory) { accessoryType = accessory; }
    Accessory accessory() const { return accessoryType; }

    void setLayoutKey();
    void setLayout();
    /// What the labels are laid out in: the row without its margins, and in a wide window its middle.
    QRectF contentFrame() const;

    double maximumOffset() const;
    void setOffset(double offset);
    void setHighlighted(bool highlighted);
    bool isHighlighted() const { return highlighted; }

protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void changeEvent(QEvent* event) override;

private:
    PelorusCell(QString reuseIdentifier, bool leaf, QWidget* parent);
    Rect bounds() const;
    void layOut();
    void paintName(QPainter& painter, const QColor& background) const;
    void paintStrip(QPainter& painter, const QColor& background) const;

    QString identifier;
    TextLabel keyLabel;
    std::optional<TextLabel> valueLabel;
    std::optional<ScrollView> view;
    Accessory accessoryType = Accessory::none;
    bool highlighted = false;
};

} // namespace pelorus
