// Where text may be drawn (Tavo_GrTextReach.h): the extents of texts and text
// boxes, and the reach by which the pass widens its search for them.
#include "Tavo_GrTextReach.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

bool Within(const Tavo_GrWRect& inner, const Tavo_GrWRect& bounds, const Tavo_GrWPoint& reach)
{
    return inner.x1 >= bounds.x1 - reach.x && inner.y1 >= bounds.y1 - reach.y && inner.x2 <= bounds.x2 + reach.x && inner.y2 <= bounds.y2 + reach.y;
}

TEST(TextReach, AtTheFloorTextIsAsLongAndHighAsAtThatCharacterHeight)
{
    const Tavo_GrWRect nominal{100, 45, 150, 55}; // 10 characters 5 high, left-aligned at (100, 50)
    const double floor = Tavo_GrText::Floor(16, 2.0);
    EXPECT_EQ(floor, 8.0);
    EXPECT_EQ(Tavo_GrText::PointExtent(nominal, {100, 50}, 5, 10, Tavo_GrAttr::AlignLeft, floor),
              (Tavo_GrWRect{100, 38, 180, 62}));
    EXPECT_EQ(Tavo_GrText::PointExtent(nominal, {100, 50}, 5, 10, Tavo_GrAttr::AlignLeft, 0.0),
              (Tavo_GrWRect{100, 42, 150, 58}))
        << "without a floor only the cell's offset from the baseline is added";
    EXPECT_EQ(Tavo_GrText::Floor(0, 2.0), 0.0);
    EXPECT_EQ(Tavo_GrText::Floor(8, 0.0), 0.0) << "no scale, no floor";

    // A right-aligned box draws its lines left of its left edge, "..." below it.
    EXPECT_EQ(Tavo_GrText::BoxExtent({200, 100, 260, 140}, 10, 30, Tavo_GrAttr::AlignRight, 0.0),
              (Tavo_GrWRect{140, 80, 260, 140}));
}

TEST(TextReach, EveryExtentLiesWithinItsBoundsWidenedByTheReachOfAnyGroupHoldingIt)
{
    const std::string longText(40, 'm');
    const char* texts[] = {"", "a", "abcdefg", longText.c_str()};
    const int heights[] = {-6, 0, 1, 5, 13, 40};
    const char aligns[] = {0, 5, 6, 7, 9, 14, 15};
    const Tavo_GrWRect boxes[] = {{0, 0, 0, 0}, {10, 20, 13, 90}, {-50, -5, 0, 5}, {100, 100, 500, 110}};
    const struct {
        int pixels;
        double scale;
    } floors[] = {{0, 1.0}, {8, 1.0}, {8, 0.25}, {8, 3.0}, {16, 0.5}, {3, 0.01}};

    // Nominal bounds as the builder makes them; one group holding everything.
    struct Item {
        bool box;
        Tavo_GrWRect bounds;
        Tavo_GrWPoint anchor;
        int height;
        int length;
        char align;
        Tavo_GrText::Facts facts;
    };
    std::vector<Item> items;
    Tavo_GrText::Facts all;
    for (const char* text : texts)
        for (int height : heights)
            for (char align : aligns) {
                const int length = static_cast<int>(std::string(text).size());
                Tavo_GrDrawing drawing;
                Tavo_GrDrawingBuilder build(drawing);
                build.SetAttr(Tavo_GrAttr(0, 0, height, align));
                build.AddText(7, -3, text);
                Item point{false, drawing.GetBounds(), {7, -3}, height, length, align, {}};
                point.facts.AddPointText(height, length);
                items.push_back(point);
                for (const Tavo_GrWRect& box : boxes) {
                    Item boxed{true, box, {}, height, length, align, {}};
                    boxed.facts.AddBoxText(box, height, length, align);
                    items.push_back(boxed);
                }
            }
    for (const Item& item : items)
        all.Add(item.facts);

    for (const auto& f : floors) {
        const double floor = Tavo_GrText::Floor(f.pixels, f.scale);
        const Tavo_GrWPoint reachOfAll = all.Reach(floor);
        for (const Item& item : items) {
            const Tavo_GrWRect extent = item.box
                ? Tavo_GrText::BoxExtent(item.bounds, item.height, item.length, item.align, floor)
                : Tavo_GrText::PointExtent(item.bounds, item.anchor, item.height, item.length, item.align, floor);
            SCOPED_TRACE(testing::Message() << (item.box ? "box" : "text") << " height " << item.height << " length "
                                            << item.length << " align " << int(item.align) << " floor " << floor);
            EXPECT_TRUE(Within(item.bounds, extent, {0, 0})) << "the extent holds the nominal bounds";
            EXPECT_TRUE(Within(extent, item.bounds, item.facts.Reach(floor)));
            EXPECT_TRUE(Within(extent, item.bounds, reachOfAll));
        }
    }
    EXPECT_EQ(Tavo_GrText::Facts().Reach(8.0), (Tavo_GrWPoint{0, 0})) << "no text, no reach";
}

} // namespace
