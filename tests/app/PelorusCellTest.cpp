#include "app/PelorusCell.h"

#include <QApplication>
#include <QFontMetricsF>
#include <gtest/gtest.h>

namespace pelorus::test {
namespace {

QFont systemFontOf(int size, QFont::Weight weight)
{
    QFont font = QApplication::font();
    font.setPixelSize(size);
    font.setWeight(weight);
    return font;
}

/// A cell whose content view is that wide: the row has a right margin of 10.
class Cell : public testing::Test {
protected:
    QSizeF bold(const QString& text) { return QFontMetricsF(systemFontOf(15, QFont::Bold)).size(0, text); }
    QSizeF regular(const QString& text)
    {
        return QFontMetricsF(systemFontOf(15, QFont::Normal)).size(0, text);
    }

    std::unique_ptr<PelorusCell> leaf(const QString& key, const QString& value, int width)
    {
        std::unique_ptr<PelorusCell> cell(PelorusCell::initWithStyle("id", nullptr));
        cell->resize(width + 10, 50);
        cell->setKey(key);
        cell->setValue(value);
        cell->setLayout();
        return cell;
    }
};

TEST_F(Cell, ShowsAnInnerNodesNameInBold15)
{
    const std::unique_ptr<PelorusCell> cell(PelorusCell::initWithStyleKey("id", nullptr));
    cell->resize(330, 50);
    cell->setKey("Serving cell");
    cell->setLayoutKey();
    EXPECT_EQ(cell->key().font().pixelSize(), 15);
    EXPECT_TRUE(cell->key().font().bold());
    EXPECT_EQ(cell->value(), nullptr);
    EXPECT_EQ(cell->scrollView(), nullptr);
    const QSizeF size = bold("Serving cell");
    EXPECT_EQ(cell->key().frame, QRectF(10, (50 - size.height()) / 2, size.width(), size.height()));
}

TEST_F(Cell, ShowsALeafsNameInBold15AndItsValueInRegular15AtTheRightEdge)
{
    const auto cell = leaf("Band", "3", 320);
    EXPECT_EQ(cell->key().font().pixelSize(), 15);
    EXPECT_TRUE(cell->key().font().bold());
    EXPECT_EQ(cell->value()->font().pixelSize(), 15);
    EXPECT_FALSE(cell->value()->font().bold());
    const QSizeF key = bold("Band");
    const QSizeF value = regular("3");
    EXPECT_EQ(cell->key().frame, QRectF(10, (50 - key.height()) / 2, key.width(), key.height()));
    EXPECT_EQ(cell->value()->frame,
              QRectF(320 - value.width(), (50 - value.height()) / 2, value.width(), value.height()));
    EXPECT_EQ(cell->scrollView()->frame, QRectF(0, 0, 320, 50));
    EXPECT_EQ(cell->scrollView()->contentSize, QSizeF(320, 50));
    EXPECT_EQ(cell->maximumOffset(), 0);
}

TEST_F(Cell, ScrollsWhatDoesNotFit)
{
    const QString name = "Num of Consecutive DRX Cycles of S < 0";
    const auto cell = leaf(name, "Not applicable", 320);
    const QSizeF key = bold(name);
    const QSizeF value = regular("Not applicable");
    ASSERT_GT(key.width() + 60 + value.width(), 320);
    EXPECT_EQ(cell->value()->frame.x(), 10 + key.width() + 50);
    EXPECT_EQ(cell->scrollView()->contentSize, QSizeF(320 + key.width() + value.width(), 50));
    EXPECT_EQ(cell->maximumOffset(), key.width() + value.width());
    cell->setOffset(-3);
    EXPECT_EQ(cell->scrollView()->offset, 0);
    cell->setOffset(1e9);
    EXPECT_EQ(cell->scrollView()->offset, key.width() + value.width());
    cell->setValue("x");
    cell->setKey("y");
    cell->setLayout();
    EXPECT_EQ(cell->scrollView()->offset, 0) << "nothing is left to scroll";
}

TEST_F(Cell, MeasuresTextsWithLineFeedsAsOneLine)
{
    const auto cell = leaf("Name", "one\ntwo", 320);
    EXPECT_EQ(cell->value()->frame.height(), regular("one two").height());
}

TEST_F(Cell, MeasuresTextsWithAnyOtherLineBreakAsOneLine)
{
    const auto cell = leaf("Name", QStringLiteral("one\u2028two"), 320);
    EXPECT_EQ(cell->value()->frame.size(), regular("one two"));
    EXPECT_EQ(cell->value()->text(), QStringLiteral("one\u2028two")) << "which is what is copied";
}

TEST_F(Cell, AnInnerNodesLongNameEndsBeforeItsArrow)
{
    const std::unique_ptr<PelorusCell> cell(PelorusCell::initWithStyleKey("id", nullptr));
    cell->resize(330, 50);
    cell->setAccessory(PelorusCell::Accessory::disclosureIndicator);
    const auto pictureOf = [&](const QString& name) {
        cell->setKey(name);
        cell->setLayoutKey();
        return cell->grab().toImage();
    };
    const QRect arrow(300, 0, 30, 49);
    const QImage shortName = pictureOf("M");
    const QImage longName = pictureOf(QString(200, u'M'));
    EXPECT_EQ(longName.copy(arrow), shortName.copy(arrow));
    EXPECT_NE(longName.copy(0, 0, 200, 49), shortName.copy(0, 0, 200, 49));
}

TEST_F(Cell, KeepsNameAndValueTogetherInAWideWindow)
{
    const auto cell = leaf("Band", "3", 1990);
    EXPECT_EQ(cell->contentFrame(), QRectF(635, 0, 720, 50));
    EXPECT_EQ(cell->value()->frame.right(), 720);
}

} // namespace
} // namespace pelorus::test
