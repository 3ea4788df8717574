// Importing into core drawings: layers and their visibility, colours on the
// library's palette, the world scale, what an imported drawing looks like
// through the GDI surface, every kind of bad input, the limits, and every
// input the fuzzer kept or found trouble with.
#include "DxfTestSupport.h"

#include "DibCanvas.h"
#include "Tavo_DxfImport.h"
#include "Tavo_DxfPaletteColours.h"
#include "Tavo_GrDrawing.h"
#include "Tavo_GrMapping.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"
#include "Tavo_WiWin32Surface.h"

#include <gtest/gtest.h>

#include <climits>
#include <cstdlib>

namespace {

const int kLevelsPerDoubling = 5;

struct Imported {
    Tavo_GrDrawing drawing;
    Tavo_DxfImportResult result;
};

std::unique_ptr<Imported> ImportFile(const std::string& path, Tavo_WiPalette& palette,
                                     const Tavo_DxfLimits& limits = Tavo_DxfLimits())
{
    auto imported = std::make_unique<Imported>();
    Tavo_DxfPaletteColours colours(palette);
    imported->result = Tavo_DxfImportFile(path.c_str(), imported->drawing, colours, limits);
    return imported;
}

// ---- Layers, colours, scale --------------------------------------------------------------

TEST(DxfImport, LayersBecomeCoreLayersAndHiddenOnesAreInvisible)
{
    Tavo_WiPalette palette;
    auto imported = ImportFile(DxfTestData("layers.dxf"), palette);
    ASSERT_TRUE(imported->result.ok) << imported->result.error.text;
    const Tavo_GrDrawing& drawing = imported->drawing;
    ASSERT_EQ(drawing.GetLayerCount(), 7);
    const struct {
        const char* name;
        bool visible;
        int items;
    } expected[] = {{"Walls", true, 4}, {"Hidden", false, 1}, {"Frozen", false, 1}, {"Orange", true, 1}, {"TrueColour", true, 1}, {"0", true, 0}, {"Extra", true, 1}};
    for (int i = 0; i < 7; ++i) {
        EXPECT_STREQ(drawing.GetLayer(i)->GetName(), expected[i].name);
        EXPECT_EQ(drawing.GetLayer(i)->IsVisible(), expected[i].visible) << expected[i].name;
        EXPECT_EQ(drawing.GetLayer(i)->GetItemCount(), expected[i].items) << expected[i].name;
    }
    EXPECT_EQ(imported->result.itemsMade, 9);
    EXPECT_EQ(imported->result.layersMade, 7);
}

TEST(DxfImport, NamedColoursAreUsedAndOthersAddedByValue)
{
    Tavo_WiPalette palette;
    auto imported = ImportFile(DxfTestData("layers.dxf"), palette);
    ASSERT_TRUE(imported->result.ok);
    // Red, blue, green, black and cyan are built in; orange (ACI 30), the
    // layer's true colour and the line's true colour are added, in that order.
    ASSERT_EQ(palette.GetColorCount(), 19);
    EXPECT_EQ(palette.GetWin32Color(16, false), RGB(255, 127, 0));
    EXPECT_EQ(palette.GetWin32Color(17, false), RGB(0x12, 0x34, 0x56));
    EXPECT_EQ(palette.GetWin32Color(18, false), RGB(0xC8, 0x64, 0x00));
    EXPECT_STREQ(palette.GetColorName(16), "dxf FF7F00");

    // Importing again finds the colours already there.
    auto again = ImportFile(DxfTestData("layers.dxf"), palette);
    ASSERT_TRUE(again->result.ok);
    EXPECT_EQ(palette.GetColorCount(), 19);
}

TEST(DxfImport, AFullPaletteGivesTheNearestColour)
{
    Tavo_WiPalette palette;
    for (int i = palette.GetColorCount(); i < Tavo_WiPalette::kMaxEntries; ++i)
        palette.AddColor("filler", 0, 0, static_cast<unsigned char>(i));
    Tavo_DxfPaletteColours colours(palette);
    EXPECT_EQ(colours.ColourIndexOf({250, 2, 3}), 4);   // near enough to red
    EXPECT_EQ(colours.ColourIndexOf({255, 127, 0}), 4); // orange: no room, red is nearest
    EXPECT_EQ(colours.ColourIndexOf({0, 0, 100}), 100); // a filler holds exactly that
    const int full = Tavo_WiPalette::kMaxEntries;
    EXPECT_EQ(palette.GetColorCount(), full);
}

TEST(DxfImport, ExtentsAreScaledByAPowerOfTenIntoTheIntegerWorld)
{
    Tavo_WiPalette palette;
    auto imported = ImportFile(DxfTestData("entities.dxf"), palette);
    ASSERT_TRUE(imported->result.ok);
    const Tavo_DxfImportResult& result = imported->result;
    // Extents 0 ... 105 wide (the text reaches up to 105): 10^6 units per
    // drawing unit keeps them within 2^28.
    EXPECT_EQ(result.scale, 1e6);
    const Tavo_GrWRect bounds = imported->drawing.GetBounds();
    const double span = std::max(double(bounds.x2) - bounds.x1, double(bounds.y2) - bounds.y1);
    EXPECT_GT(span, Tavo_DxfImportResult::kWorldSpan / 10);
    EXPECT_LE(span, Tavo_DxfImportResult::kWorldSpan * 1.01);
    // The line from (0,0) to (100,0) is 10^8 units long.
    EXPECT_EQ(std::lround((100 - result.originX) * result.scale) - std::lround((0 - result.originX) * result.scale),
              100000000);
}

TEST(DxfImport, ImportedDrawingPaintsItsColoursThroughTheSurface)
{
    // The surface draws with the library's palette.
    Tavo_WiPalette& palette = *Tavo_WiLibrary::GetPalette();
    auto imported = ImportFile(DxfTestData("layers.dxf"), palette);
    ASSERT_TRUE(imported->result.ok);
    DibCanvas canvas(400, 300);
    ASSERT_TRUE(canvas.IsValid());
    Tavo_GrMapping mapping(&imported->drawing, kLevelsPerDoubling);
    mapping.SetZeroLevelExpansion(10); // the outermost lines away from the edges
    mapping.SetDeviceWindowSize(400, 300, true, nullptr);
    Tavo_WiWin32Surface surface;
    surface.SetDC(canvas.GetDC());
    imported->drawing.Draw(surface, mapping, nullptr);
    EXPECT_GT(canvas.CountPixels(RGB(255, 0, 0)), 300);   // Walls
    EXPECT_GT(canvas.CountPixels(RGB(255, 127, 0)), 300); // Orange
    EXPECT_EQ(canvas.CountPixels(RGB(0, 255, 0)), 0);     // Frozen is not drawn
}

// ---- Bad input ----------------------------------------------------------------------------

struct BadInput {
    const char* file;
    bool imports;        // false: refused
    int line;            // of the error, or of the warning
    const char* message; // part of the error or of a warning
    int items;           // made when it imports
};

const BadInput kBadInputs[] = {
    {"truncated.dxf", false, 22, "the file ends inside an entity", 0},
    {"ends_after_code.dxf", false, 25, "ends after group code 21", 0},
    {"bad_group_code.dxf", false, 17, "expected a group code (a number) but found \"ten\"", 0},
    {"binary.dxf", false, 1, "binary DXF is not supported", 0},
    {"empty.dxf", false, 0, "the file is empty", 0},
    {"huge_array.dxf", false, 65, "inserts expand to more than", 0},
    {"exponential_blocks.dxf", false, 289, "expands to more than", 0},
    {"unknown_entity.dxf", true, 15, "HATCH: skipped, not supported (2 times", 1},
    {"unknown_entity.dxf", true, 23, "WIDGET: skipped, not supported", 1},
    {"unknown_section.dxf", true, 11, "section GIZMOS: skipped", 1},
    {"bad_numbers.dxf", true, 15, "LINE: skipped, group code 10 at line 19 is not a finite number", 1},
    {"bad_numbers.dxf", true, 39, "CIRCLE: skipped, group code 40 at line 47 holds an absurdly large number", 1},
    {"bad_numbers.dxf", true, 49, "CIRCLE: skipped, its radius is negative", 1},
    {"bad_numbers.dxf", true, 85, "INSERT: skipped, group code 62 at line 95 is not a whole number", 1},
    {"cyclic_blocks.dxf", true, 67, "block \"A\" inserts itself (a cyclic block reference)", 2},
    {"cyclic_blocks.dxf", true, 103, "block \"SELF\" inserts itself", 2},
    {"missing_block.dxf", true, 15, "block \"NOWHERE\" is not defined", 1},
    {"zero_scale.dxf", true, 49, "its scale is zero", 1},
    {"deep_nesting.dxf", true, 599, "nested deeper than 16", 16},
    {"absurd_scale.dxf", true, 89, "out of range once its inserts are applied", 1},
};

class DxfBadInput : public ::testing::TestWithParam<BadInput> {};

TEST_P(DxfBadInput, IsRefusedWithItsLineOrSkippedWithAWarning)
{
    const BadInput& bad = GetParam();
    Tavo_WiPalette palette;
    auto imported = ImportFile(DxfTestData(std::string("bad/") + bad.file), palette);
    const Tavo_DxfImportResult& result = imported->result;
    EXPECT_EQ(result.ok, bad.imports) << result.error.text;
    if (!bad.imports) {
        EXPECT_EQ(result.error.line, bad.line);
        EXPECT_NE(result.error.text.find(bad.message), std::string::npos) << result.error.text;
        EXPECT_EQ(imported->drawing.GetLayerCount(), 0) << "a refused file adds nothing";
        EXPECT_EQ(imported->drawing.GetItemCount(), 0);
        return;
    }
    EXPECT_EQ(result.itemsMade, bad.items);
    bool found = false;
    for (const Tavo_DxfMessage& warning : result.warnings)
        if (warning.text.find(bad.message) != std::string::npos) {
            found = true;
            EXPECT_EQ(warning.line, bad.line) << warning.text;
        }
    EXPECT_TRUE(found) << "no warning saying: " << bad.message;
}

INSTANTIATE_TEST_SUITE_P(EveryKind, DxfBadInput, ::testing::ValuesIn(kBadInputs));

TEST(DxfLimits, FilesLargerThanTheLimitAreRefusedBeforeReading)
{
    Tavo_WiPalette palette;
    Tavo_DxfLimits limits;
    limits.maxInputBytes = 100;
    auto imported = ImportFile(DxfTestData("entities.dxf"), palette, limits);
    EXPECT_FALSE(imported->result.ok);
    EXPECT_NE(imported->result.error.text.find("larger than 100 bytes"), std::string::npos);

    Tavo_GrDrawing drawing;
    Tavo_DxfPaletteColours colours(palette);
    const std::string text = ReadWholeFile(DxfTestData("entities.dxf"));
    EXPECT_FALSE(Tavo_DxfImport(text.data(), text.size(), drawing, colours, limits).ok);
    EXPECT_FALSE(Tavo_DxfImportFile(DxfTestData("no-such-file.dxf").c_str(), drawing, colours).ok);
}

TEST(DxfLimits, ItemPointAndTextLimitsRefuseTheWholeDrawing)
{
    const struct {
        long long Tavo_DxfLimits::*limit;
        long long value;
        const char* says;
    } cases[] = {
        {&Tavo_DxfLimits::maxItems, 12, "more than 12 items"},
        {&Tavo_DxfLimits::maxPoints, 50, "more than 50 points"},
        {&Tavo_DxfLimits::maxTextBytes, 10, "more than 10 bytes of text"},
        {&Tavo_DxfLimits::maxWork, 5, "more than 5 entities"},
    };
    for (const auto& c : cases) {
        Tavo_WiPalette palette;
        Tavo_DxfLimits limits;
        limits.*c.limit = c.value;
        auto imported = ImportFile(DxfTestData("entities.dxf"), palette, limits);
        EXPECT_FALSE(imported->result.ok) << c.says;
        EXPECT_NE(imported->result.error.text.find(c.says), std::string::npos) << imported->result.error.text;
        EXPECT_GT(imported->result.error.line, 0);
        EXPECT_EQ(imported->drawing.GetItemCount(), 0);
    }
}

TEST(DxfLimits, WarningsBeyondTheLimitAreCounted)
{
    std::string text = "  0\nSECTION\n  2\nENTITIES\n";
    for (int i = 0; i < 30; ++i)
        text += "  0\nKIND" + std::to_string(i) + "\n";
    text += "  0\nENDSEC\n  0\nEOF\n";
    Tavo_WiPalette palette;
    Tavo_DxfPaletteColours colours(palette);
    Tavo_GrDrawing drawing;
    Tavo_DxfLimits limits;
    limits.maxWarnings = 10;
    const Tavo_DxfImportResult result = Tavo_DxfImport(text.data(), text.size(), drawing, colours, limits);
    ASSERT_TRUE(result.ok);
    EXPECT_EQ(result.warnings.size(), 10u);
    EXPECT_EQ(result.droppedWarnings, 21); // 20 kinds, and "nothing to draw"
    EXPECT_EQ(result.entitiesRead, 30);
    EXPECT_EQ(result.entitiesSkipped, 30);
}

// ---- What the fuzzer kept and found ---------------------------------------------------------

TEST(DxfFuzzReplay, EveryKeptAndCrashingInputImportsOrIsRefused)
{
    std::vector<std::string> inputs = FilesUnder(std::string(TAVO_DXF_FUZZ_DIR) + "/corpus", {""});
    ASSERT_GT(inputs.size(), 20u) << "the fuzz corpus in " << TAVO_DXF_FUZZ_DIR;
    const std::vector<std::string> crashes = FilesUnder(std::string(TAVO_DXF_FUZZ_DIR) + "/crashes", {""});
    inputs.insert(inputs.end(), crashes.begin(), crashes.end());
    int imported = 0;
    int refused = 0;
    Tavo_WiPalette& palette = *Tavo_WiLibrary::GetPalette();
    for (const std::string& path : inputs) {
        auto result = ImportFile(path, palette);
        if (result->result.ok) {
            ++imported;
            // Drawn too, as a window would.
            DibCanvas canvas(200, 150);
            Tavo_GrMapping mapping(&result->drawing, kLevelsPerDoubling);
            mapping.SetDeviceWindowSize(200, 150, true, nullptr);
            Tavo_WiWin32Surface surface;
            surface.SetDC(canvas.GetDC());
            result->drawing.Draw(surface, mapping, nullptr);
        } else {
            ++refused;
            EXPECT_FALSE(result->result.error.text.empty()) << path;
        }
    }
    std::printf("fuzz inputs: %d imported, %d refused\n", imported, refused);
}

} // namespace
