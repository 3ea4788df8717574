// The render program's parts: the PNG writer and the built-in sample drawing.
#include "SurfaceFixture.h"

#include "PngWriter.h"
#include "SampleDrawing.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrMapping.h"

#include <wincodec.h>
#include <wrl/client.h>

#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

using Microsoft::WRL::ComPtr;

namespace {

std::string TempPngPath()
{
    char folder[MAX_PATH] = {};
    GetTempPathA(MAX_PATH, folder);
    return std::string(folder) + "tavo_surface_test.png";
}

// Decodes a PNG into 32-bit BGRA pixels; empty on failure.
std::vector<std::uint32_t> ReadPng(const std::string& path, UINT& width, UINT& height)
{
    std::vector<std::uint32_t> pixels;
    CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED);
    {
        ComPtr<IWICImagingFactory> factory;
        ComPtr<IWICBitmapDecoder> decoder;
        ComPtr<IWICBitmapFrameDecode> frame;
        ComPtr<IWICFormatConverter> converter;
        const std::wstring widePath(path.begin(), path.end());
        if (SUCCEEDED(CoCreateInstance(CLSID_WICImagingFactory, nullptr, CLSCTX_INPROC_SERVER, IID_PPV_ARGS(&factory)))
            && SUCCEEDED(factory->CreateDecoderFromFilename(widePath.c_str(), nullptr, GENERIC_READ,
                                                            WICDecodeMetadataCacheOnDemand, &decoder))
            && SUCCEEDED(decoder->GetFrame(0, &frame)) && SUCCEEDED(frame->GetSize(&width, &height))
            && SUCCEEDED(factory->CreateFormatConverter(&converter))
            && SUCCEEDED(converter->Initialize(frame.Get(), GUID_WICPixelFormat32bppBGRA, WICBitmapDitherTypeNone,
                                               nullptr, 0.0, WICBitmapPaletteTypeCustom))) {
            pixels.resize(static_cast<size_t>(width) * height);
            if (FAILED(converter->CopyPixels(nullptr, width * 4, width * height * 4,
                                             reinterpret_cast<BYTE*>(pixels.data()))))
                pixels.clear();
        }
    }
    CoUninitialize();
    return pixels;
}

} // namespace

TEST(PngWriter, WritesOpaquePixelsTopDown)
{
    DibCanvas canvas(8, 4, RGB(255, 255, 255));
    SetPixelV(canvas.GetDC(), 0, 0, RGB(255, 0, 0));
    SetPixelV(canvas.GetDC(), 7, 3, RGB(0, 0, 255));
    const std::string path = TempPngPath();
    ASSERT_EQ("", WritePng(canvas, path));

    UINT width = 0, height = 0;
    const std::vector<std::uint32_t> pixels = ReadPng(path, width, height);
    std::remove(path.c_str());
    ASSERT_EQ(8u, width);
    ASSERT_EQ(4u, height);
    ASSERT_EQ(32u, pixels.size());
    EXPECT_EQ(0xFFFF0000u, pixels[0]) << "red, opaque, in the top-left corner";
    EXPECT_EQ(0xFF0000FFu, pixels[31]) << "blue, opaque, in the bottom-right corner";
    EXPECT_EQ(0xFFFFFFFFu, pixels[1]);
}

TEST(PngWriter, ReportsAFileThatCannotBeWritten)
{
    DibCanvas canvas(8, 4);
    EXPECT_NE("", WritePng(canvas, "Z:\\no such folder\\at all\\picture.png"));
    DibCanvas empty(0, 0);
    EXPECT_NE("", WritePng(empty, TempPngPath()));
}

TEST(SampleDrawing, ExercisesEveryPrimitiveKindAndText)
{
    Tavo_GrDrawing drawing;
    BuildSampleDrawing(drawing);
    const Tavo_GrWRect bounds = drawing.GetBounds();
    EXPECT_EQ(0, bounds.x1);
    EXPECT_EQ(0, bounds.y1);
    EXPECT_EQ(kSampleWidth, bounds.x2);
    EXPECT_EQ(kSampleHeight, bounds.y2);

    DibCanvas canvas(kSampleWidth, kSampleHeight);
    Tavo_GrMapping mapping(&drawing, 5);
    mapping.SetDeviceWindowSize(kSampleWidth, kSampleHeight, true, nullptr);
    Tavo_WiWin32Surface surface;
    surface.SetDC(canvas.GetDC());
    drawing.Draw(surface, mapping, nullptr);

    Tavo_GrSurfaceStats stats;
    surface.FetchStats(stats);
    for (Tavo_GrSurfaceStats::Counter counter :
         {Tavo_GrSurfaceStats::Dots, Tavo_GrSurfaceStats::Lines, Tavo_GrSurfaceStats::HollowTriangles,
          Tavo_GrSurfaceStats::HollowRects, Tavo_GrSurfaceStats::FilledTriangles, Tavo_GrSurfaceStats::FilledRects,
          Tavo_GrSurfaceStats::Circles, Tavo_GrSurfaceStats::Texts})
        EXPECT_GT(stats.Get(counter), 0u) << "counter " << counter;
    for (char colour = 0; colour < 16; ++colour)
        EXPECT_GT(canvas.CountPixels(ColourOf(colour)), 0) << "colour " << int(colour);
}
