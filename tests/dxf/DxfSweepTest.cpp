// Every drawing of Debian's librecad-data package (title sheets, mechanical,
// electrical and architectural symbols, hatch patterns): each one imports or
// is refused with an error that has a text; none crashes. The counts are
// printed.
#include "DxfTestSupport.h"

#include "Tavo_DxfImport.h"
#include "Tavo_DxfPaletteColours.h"
#include "Tavo_GrDrawing.h"
#include "Tavo_WiPalette.h"

#include <gtest/gtest.h>

#include <cstdio>

namespace {

TEST(DxfSampleDrawings, EachImportsOrIsRefusedWithAnError)
{
    const std::vector<std::string> files = FilesUnder(TAVO_DXF_SAMPLES, {".dxf"});
    ASSERT_GT(files.size(), 1000u) << "the librecad-data drawings in " << TAVO_DXF_SAMPLES
                                   << " (Debian package librecad-data)";
    int imported = 0;
    int refused = 0;
    int withWarnings = 0;
    long long items = 0;
    for (const std::string& path : files) {
        Tavo_WiPalette palette;
        Tavo_DxfPaletteColours colours(palette);
        Tavo_GrDrawing drawing;
        const Tavo_DxfImportResult result = Tavo_DxfImportFile(path.c_str(), drawing, colours);
        if (!result.ok) {
            ++refused;
            EXPECT_FALSE(result.error.text.empty()) << path;
            std::printf("refused %s: line %d: %s\n", path.c_str(), result.error.line, result.error.text.c_str());
            continue;
        }
        ++imported;
        items += result.itemsMade;
        withWarnings += result.warnings.empty() ? 0 : 1;
        EXPECT_EQ(drawing.GetItemCount(), result.itemsMade) << path;
        // Everything lands well inside the int range.
        const Tavo_GrWRect bounds = drawing.GetBounds();
        EXPECT_LE(double(bounds.x2) - bounds.x1, Tavo_DxfImportResult::kWorldSpan * 1.01) << path;
        EXPECT_LE(double(bounds.y2) - bounds.y1, Tavo_DxfImportResult::kWorldSpan * 1.01) << path;
    }
    std::printf("librecad-data: %zu drawings: %d imported (%d with warnings, %lld items in all), %d refused\n",
                files.size(), imported, withWarnings, items, refused);
    EXPECT_EQ(imported + refused, static_cast<int>(files.size()));
}

} // namespace
