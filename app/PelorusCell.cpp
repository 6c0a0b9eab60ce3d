#include "app/PelorusCell.h"

#include "app/Chevron.h"

#include <QEvent>
#include <algorithm>

namespace pelorus {

namespace {

constexpr double kRightMargin = 10;    // as wide as the one that the layout leaves on the left
constexpr double kReadableWidth = 720; // names and values farther apart are hard to read together
constexpr double kChevronHeight = 11;
constexpr double kChevronRoom = 24;
constexpr double kFade = 28;

QRectF toQt(const Rect& rect)
{
    return {rect.x, rect.y, rect.width, rect.height};
}

/// Where a text goes on: into the background, which is all there is at `to`.
void paintFade(QPainter& painter, const QColor& background, double from, double to)
{
    QLinearGradient gradient(from, 0, to, 0);
    QColor clear = background;
    clear.setAlpha(0);
    gradient.setColorAt(0, clear);
    gradient.setColorAt(1, background);
    painter.fillRect(QRectF(std::min(from, to), 0, kFade, kStripHeight - 1), gradient);
}

} // namespace

PelorusCell* PelorusCell::initWithStyleKey(const QString& reuseIdentifier, QWidget* parent)
{
    return new PelorusCell(reuseIdentifier, false, parent);
}

PelorusCell* PelorusCell::initWithStyle(const QString& reuseIdentifier, QWidget* parent)
{
    return new PelorusCell(reuseIdentifier, true, parent);
}

PelorusCell::PelorusCell(QString reuseIdentifier, bool leaf, QWidget* parent)
    : QWidget(parent), identifier(std::move(reuseIdentifier)),
      keyLabel(systemFont(kCellFontSize, QFont::Bold))
{
    if (leaf) {
        valueLabel.emplace(systemFont(kCellFontSize));
        view = ScrollView{};
    }
    setFocusPolicy(Qt::NoFocus);
    setAttribute(Qt::WA_TransparentForMouseEvents); // the table knows what to do with them
    setAttribute(Qt::WA_OpaquePaintEvent);
}

void PelorusCell::setKey(const QString& text)
{
    if (keyLabel.setText(text))
        update();
}

void PelorusCell::setValue(const QString& text)
{
    if (valueLabel && valueLabel->setText(text))
        update();
}

QRectF PelorusCell::contentFrame() const
{
    const double available = std::max(0.0, width() - kRightMargin);
    const double used = std::min(available, kReadableWidth);
    return {std::floor((width() - std::min<double>(width(), kReadableWidth + kRightMargin)) / 2), 0, used,
            static_cast<double>(height())};
}

Rect PelorusCell::bounds() const
{
    const QRectF frame = contentFrame();
    return {0, 0, frame.width(), frame.height()};
}

void PelorusCell::setLayoutKey()
{
    keyLabel.frame = toQt(keyFrame(bounds(), keyLabel.size()));
}

void PelorusCell::setLayout()
{
    const LeafLayout layout = leafLayout(bounds(), keyLabel.size(), valueLabel ? valueLabel->size() : Size{});
    keyLabel.frame = toQt(layout.key);
    if (!view)
        return;
    valueLabel->frame = toQt(layout.value);
    view->frame = toQt(layout.scrollView);
    view->contentSize = {layout.contentSize.width, layout.contentSize.height};
    setOffset(view->offset);
}

double PelorusCell::maximumOffset() const
{
    return view ? std::max(0.0, view->contentSize.width() - view->frame.width()) : 0;
}

void PelorusCell::setOffset(double offset)
{
    const double possible = std::clamp(offset, 0.0, maximumOffset());
    if (!view || view->offset == possible)
        return;
    view->offset = possible;
    update();
}

void PelorusCell::setHighlighted(bool chosen)
{
    if (highlighted == chosen)
        return;
    highlighted = chosen;
    update();
}

void PelorusCell::layOut()
{
    if (isLeaf())
        setLayout();
    else
        setLayoutKey();
}

void PelorusCell::resizeEvent(QResizeEvent*)
{
    layOut();
}

void PelorusCell::changeEvent(QEvent* event)
{
    if (event->type() == QEvent::PaletteChange)
        update();
    QWidget::changeEvent(event);
}

void PelorusCell::paintEvent(QPaintEvent*)
{
    QPainter painter(this);
    const QPalette& colours = palette();
    const QColor background = colours.color(highlighted ? QPalette::Highlight : QPalette::Base);
    const QColor text = colours.color(highlighted ? QPalette::HighlightedText : QPalette::Text);
    const QRectF content = contentFrame();
    painter.fillRect(rect(), background);
    // From the name to the edge of the window, or as far beyond the content of a wide one.
    const double end = std::min<double>(width(), content.right() + kRightMargin);
    painter.fillRect(QRectF(content.x() + 10, height() - 1, end - content.x() - 10, 1),
                     blend(background, text, highlighted ? 0 : 0.13));
    painter.translate(content.topLeft());
    painter.setPen(text);
    if (view)
        paintStrip(painter, background);
    else
        paintName(painter, background);
    if (accessoryType == Accessory::disclosureIndicator)
        paintChevron(painter, {content.width() - 10, (height() - kChevronHeight) / 2, 10, kChevronHeight},
                     ChevronDirection::right, blend(background, text, highlighted ? 0.9 : 0.4));
}

void PelorusCell::paintName(QPainter& painter, const QColor& background) const
{
    const double right = contentFrame().width() - kChevronRoom;
    painter.save();
    painter.setClipRect(QRectF(0, 0, right, height() - 1));
    keyLabel.paint(painter);
    if (keyLabel.frame.right() > right)
        paintFade(painter, background, right - kFade, right);
    painter.restore();
}

void PelorusCell::paintStrip(QPainter& painter, const QColor& background) const
{
    painter.save();
    painter.setClipRect(view->frame.adjusted(0, 0, 0, -1));
    painter.translate(-view->offset, 0);
    keyLabel.paint(painter);
    valueLabel->paint(painter);
    painter.translate(view->offset, 0);
    const double right = view->frame.right();
    if (valueLabel->frame.right() - view->offset > right)
        paintFade(painter, background, right - kFade, right);
    if (view->offset > 0)
        paintFade(painter, background, view->frame.left() + kFade, view->frame.left());
    painter.restore();
}

} // namespace pelorus
