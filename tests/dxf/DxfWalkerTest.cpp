// The parser and the walker on the small drawings made for the tests: each
// entity kind, blocks inserted with scale, rotation, mirroring and arrays,
// layers and colours. Shapes are checked in drawing coordinates.
#include "DxfTestSupport.h"

#include "Tavo_GrAttr.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

const Tavo_DxfRgb kBlack{0, 0, 0};
const Tavo_DxfRgb kRed{255, 0, 0};
const Tavo_DxfRgb kGreen{0, 255, 0};
const Tavo_DxfRgb kBlue{0, 0, 255};

void ExpectPoint(const Tavo_DxfXY& p, double x, double y)
{
    EXPECT_NEAR(p.x, x, 1e-9);
    EXPECT_NEAR(p.y, y, 1e-9);
}

double Largest(const std::vector<Tavo_DxfXY>& points, double Tavo_DxfXY::*axis)
{
    double largest = -1e300;
    for (const Tavo_DxfXY& p : points)
        largest = std::max(largest, p.*axis);
    return largest;
}

double Smallest(const std::vector<Tavo_DxfXY>& points, double Tavo_DxfXY::*axis)
{
    double smallest = 1e300;
    for (const Tavo_DxfXY& p : points)
        smallest = std::min(smallest, p.*axis);
    return smallest;
}

// ---- Each entity kind -----------------------------------------------------------------

class EntitiesFile : public ::testing::Test {
protected:
    WalkedDxf m_dxf{ReadWholeFile(DxfTestData("entities.dxf"))};
    const std::vector<RecordingSink::Shape>& Shapes() const { return m_dxf.sink.shapes; }
};

TEST_F(EntitiesFile, EveryEntityKindBecomesTheShapeTheCoreCanDraw)
{
    ASSERT_TRUE(m_dxf.ok) << m_dxf.parsed.error;
    EXPECT_EQ(m_dxf.sink.Kinds(), "Line Polyline Polyline Polyline Circle Polyline Polyline Text Text Text Polygon Polygon Dot");
    EXPECT_EQ(m_dxf.parsed.model.version, "AC1021");
    for (const RecordingSink::Shape& shape : Shapes())
        EXPECT_EQ(shape.style.colour, kBlack) << shape.kind << ": layer 0 is ACI 7, drawn black on white";
}

TEST_F(EntitiesFile, LinesPointsAndPolylinesKeepTheirVertices)
{
    ASSERT_EQ(Shapes().size(), 13u);
    ExpectPoint(Shapes()[0].points[0], 0, 0);
    ExpectPoint(Shapes()[0].points[1], 100, 0);
    ExpectPoint(Shapes()[12].points[0], 100, 100);
    // The 3-D polyline is seen from above.
    const RecordingSink::Shape& polyline3d = Shapes()[3];
    ASSERT_EQ(polyline3d.points.size(), 2u);
    ExpectPoint(polyline3d.points[1], 50, 10);
}

TEST_F(EntitiesFile, BulgesBecomeArcsOnTheirSide)
{
    ASSERT_EQ(Shapes().size(), 13u);
    // LWPOLYLINE (0,10) (10,10) bulge 1 (10,20), closed: a half circle to the right.
    const RecordingSink::Shape& closed = Shapes()[1];
    EXPECT_TRUE(closed.closed);
    ExpectPoint(closed.points.front(), 0, 10);
    EXPECT_NEAR(Largest(closed.points, &Tavo_DxfXY::x), 15.0, 1e-3);
    // POLYLINE (20,0) bulge -1 (30,0): clockwise, so over the top.
    const RecordingSink::Shape& open = Shapes()[2];
    EXPECT_FALSE(open.closed);
    ExpectPoint(open.points.front(), 20, 0);
    ExpectPoint(open.points.back(), 30, 0);
    EXPECT_NEAR(Largest(open.points, &Tavo_DxfXY::y), 5.0, 1e-3);
}

TEST_F(EntitiesFile, CirclesStayCirclesArcsAndEllipsesAreFlattened)
{
    ASSERT_EQ(Shapes().size(), 13u);
    ExpectPoint(Shapes()[4].points[0], 50, 50);
    EXPECT_EQ(Shapes()[4].radius, 10.0);
    const RecordingSink::Shape& arc = Shapes()[5];
    ExpectPoint(arc.points.front(), 70, 50);
    ExpectPoint(arc.points.back(), 50, 70);
    for (const Tavo_DxfXY& p : arc.points)
        EXPECT_NEAR(std::hypot(p.x - 50, p.y - 50), 20.0, 1e-9);
    const RecordingSink::Shape& ellipse = Shapes()[6];
    EXPECT_TRUE(ellipse.closed);
    EXPECT_NEAR(Smallest(ellipse.points, &Tavo_DxfXY::x), 70.0, 1e-3);
    EXPECT_NEAR(Largest(ellipse.points, &Tavo_DxfXY::x), 90.0, 1e-9);
    EXPECT_NEAR(Largest(ellipse.points, &Tavo_DxfXY::y), 55.0, 1e-3);
    EXPECT_NEAR(Smallest(ellipse.points, &Tavo_DxfXY::y), 45.0, 1e-3);
}

TEST_F(EntitiesFile, TextsArePlainWithHeightAndAlignment)
{
    ASSERT_EQ(Shapes().size(), 13u);
    const RecordingSink::Shape& text = Shapes()[7];
    EXPECT_EQ(text.string, "Caf\xE9 \xD8"
                           "10 \xB0");
    ExpectPoint(text.text.anchor, 10, 60); // centred: placed at the alignment point
    EXPECT_EQ(text.text.height, 5.0);
    EXPECT_EQ(text.text.align, Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignBottom);

    // MTEXT attached top left: two lines hanging from the point.
    const RecordingSink::Shape& first = Shapes()[8];
    const RecordingSink::Shape& second = Shapes()[9];
    EXPECT_EQ(first.string, "First line");
    EXPECT_EQ(second.string, "Second \xB1 line");
    ExpectPoint(first.text.anchor, 0, 90);
    ExpectPoint(second.text.anchor, 0, 90 - 4 * 5.0 / 3.0);
    EXPECT_EQ(first.text.align, Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignTop);
}

TEST_F(EntitiesFile, SolidCornersGoRoundInTheirDxfOrder)
{
    ASSERT_EQ(Shapes().size(), 13u);
    const RecordingSink::Shape& solid = Shapes()[10];
    ASSERT_EQ(solid.points.size(), 4u);
    ExpectPoint(solid.points[0], 60, 0);
    ExpectPoint(solid.points[1], 70, 0);
    ExpectPoint(solid.points[2], 70, 10);
    ExpectPoint(solid.points[3], 60, 10);
}

TEST(R12File, OldPolylinesAndCarriageReturnsAreRead)
{
    WalkedDxf dxf(ReadWholeFile(DxfTestData("r12.dxf")));
    ASSERT_TRUE(dxf.ok) << dxf.parsed.error;
    EXPECT_EQ(dxf.sink.Kinds(), "Polyline Line");
    EXPECT_TRUE(dxf.sink.shapes[0].closed);
    EXPECT_EQ(dxf.sink.shapes[0].points.size(), 3u);
    EXPECT_EQ(dxf.parsed.model.version, "");
}

// ---- Blocks ----------------------------------------------------------------------------

class BlocksFile : public ::testing::Test {
protected:
    WalkedDxf m_dxf{ReadWholeFile(DxfTestData("blocks.dxf"))};
    const std::vector<RecordingSink::Shape>& Shapes() const { return m_dxf.sink.shapes; }
    int Layer(const char* name) const { return m_dxf.parsed.model.layerIndex.at(name); }
};

TEST_F(BlocksFile, NestedInsertsComposeScaleRotationAndBasePoints)
{
    ASSERT_TRUE(m_dxf.ok) << m_dxf.parsed.error;
    EXPECT_EQ(m_dxf.sink.Kinds().substr(0, 16), "Dot Line Circle ");
    // NEST at (100,100), scale 3, turned 90 degrees, holds LEAF at (5,0)
    // scaled 2; LEAF's base point is (1,1).
    ExpectPoint(Shapes()[0].points[0], 100, 121);
    ExpectPoint(Shapes()[1].points[0], 100, 115);
    ExpectPoint(Shapes()[1].points[1], 94, 115);
    ExpectPoint(Shapes()[2].points[0], 100, 115);
    EXPECT_NEAR(Shapes()[2].radius, 3.0, 1e-12);
}

TEST_F(BlocksFile, ByBlockAndLayerZeroTakeTheInsertsColourAndLayer)
{
    ASSERT_EQ(Shapes().size(), 27u);
    // The point is "by block" inside LEAF, whose insert inside NEST is red.
    EXPECT_EQ(Shapes()[0].style.colour, kRed);
    // The line is on layer 0 "by layer": it takes the layer of the outermost
    // insert that is not on layer 0, Parts (green).
    EXPECT_EQ(Shapes()[1].style.layer, Layer("PARTS"));
    EXPECT_EQ(Shapes()[1].style.colour, kGreen);
    // LEAF inserted directly, "by layer" on Parts: its point is green too.
    EXPECT_EQ(Shapes()[3].style.colour, kGreen);
}

TEST_F(BlocksFile, ArrayInsertsRepeatAlongColumnsAndRows)
{
    ASSERT_EQ(Shapes().size(), 27u);
    // 2 columns 10 apart, 3 rows 20 apart; each copy is point, line, circle.
    for (int row = 0; row < 3; ++row)
        for (int column = 0; column < 2; ++column) {
            const RecordingSink::Shape& dot = Shapes()[3 + 3 * (row * 2 + column)];
            ASSERT_EQ(dot.kind, "Dot");
            ExpectPoint(dot.points[0], 1 + 10 * column, 20 * row);
        }
}

TEST_F(BlocksFile, MirroredInsertsKeepCirclesUnevenScalesMakeEllipses)
{
    ASSERT_EQ(Shapes().size(), 27u);
    ExpectPoint(Shapes()[21].points[0], -51, 0); // mirrored: the point goes left
    EXPECT_EQ(Shapes()[23].kind, "Circle");
    EXPECT_NEAR(Shapes()[23].radius, 0.5, 1e-12);
    const RecordingSink::Shape& stretched = Shapes()[26];
    ASSERT_EQ(stretched.kind, "Polyline");
    EXPECT_TRUE(stretched.closed);
    EXPECT_NEAR(Smallest(stretched.points, &Tavo_DxfXY::x), -82.0, 1e-3);
    EXPECT_NEAR(Largest(stretched.points, &Tavo_DxfXY::x), -78.0, 1e-3);
    EXPECT_NEAR(Largest(stretched.points, &Tavo_DxfXY::y), 0.5, 1e-3);
}

// ---- Layers and colours ------------------------------------------------------------------

TEST(LayersFile, LayerTableColoursAndOverrides)
{
    WalkedDxf dxf(ReadWholeFile(DxfTestData("layers.dxf")));
    ASSERT_TRUE(dxf.ok) << dxf.parsed.error;
    const Tavo_DxfModel& model = dxf.parsed.model;
    ASSERT_EQ(model.layers.size(), 7u);
    EXPECT_EQ(model.layers[0].name, "Walls");
    EXPECT_EQ(model.layers[1].colour, -5); // switched off
    EXPECT_TRUE(model.layers[2].frozen);
    EXPECT_EQ(model.layers[6].name, "Extra"); // used, not in the table

    const struct {
        const char* layer;
        uint32_t rgb;
    } expected[] = {
        {"WALLS", 0xFF0000},
        {"WALLS", 0x0000FF},
        {"HIDDEN", 0x0000FF},
        {"FROZEN", 0x00FF00},
        {"ORANGE", 0xFF7F00},
        {"TRUECOLOUR", 0x123456},
        {"WALLS", 0x000000},
        {"WALLS", 0xC86400},
        {"EXTRA", 0x00FFFF},
    };
    ASSERT_EQ(dxf.sink.shapes.size(), 9u);
    for (size_t i = 0; i < 9; ++i) {
        EXPECT_EQ(dxf.sink.shapes[i].style.layer, model.layerIndex.at(expected[i].layer)) << "line " << i;
        EXPECT_EQ(dxf.sink.shapes[i].style.colour.Packed(), expected[i].rgb) << "line " << i;
    }
}

} // namespace
