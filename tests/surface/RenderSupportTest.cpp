// The render program's PNG writer.
#include "DibCanvas.h"
#include "PngWriter.h"

#include <gtest/gtest.h>

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
        ComPtr<IWICBitmapSource> converted;
        const std::wstring widePath(path.begin(), path.end());
        if (SUCCEEDED(CoCreateInstance(CLSID_WICImagingFactory, nullptr, CLSCTX_INPROC_SERVER, IID_PPV_ARGS(&factory))) && SUCCEEDED(factory->CreateDecoderFromFilename(widePath.c_str(), nullptr, GENERIC_READ, WICDecodeMetadataCacheOnDemand, &decoder)) && SUCCEEDED(decoder->GetFrame(0, &frame)) && SUCCEEDED(frame->GetSize(&width, &height)) && SUCCEEDED(WICConvertBitmapSource(GUID_WICPixelFormat32bppBGRA, frame.Get(), &converted))) {
            pixels.resize(static_cast<size_t>(width) * height);
            if (FAILED(converted->CopyPixels(nullptr, width * 4, width * height * 4, reinterpret_cast<BYTE*>(pixels.data()))))
                pixels.clear();
        }
    }
    CoUninitialize();
    return pixels;
}

} // namespace

TEST(PngWriter, WritesOpaquePixelsTopDownAndReportsWhatItCannotWrite)
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

    EXPECT_NE("", WritePng(canvas, "Z:\\no such folder\\at all\\picture.png"));
    DibCanvas empty(0, 0);
    EXPECT_NE("", WritePng(empty, TempPngPath()));
}
