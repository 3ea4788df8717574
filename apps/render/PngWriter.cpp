#include "PngWriter.h"

#include "DibCanvas.h"

#include <wincodec.h>
#include <wrl/client.h>

#include <cstdint>
#include <cstdio>
#include <vector>

using Microsoft::WRL::ComPtr;

namespace {

// COM for this thread while a PNG is written.
class ComScope {
public:
    ComScope() : m_result(CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED)) {}
    ~ComScope()
    {
        if (SUCCEEDED(m_result))
            CoUninitialize();
    }
    ComScope(const ComScope&) = delete;
    ComScope& operator=(const ComScope&) = delete;

private:
    HRESULT m_result;
};

std::string Failure(const char* step, HRESULT result)
{
    char text[96];
    std::snprintf(text, sizeof text, "%s failed (HRESULT 0x%08lX)", step, static_cast<unsigned long>(result));
    return text;
}

std::wstring Widen(const std::string& text)
{
    const int length = MultiByteToWideChar(CP_ACP, 0, text.c_str(), -1, nullptr, 0);
    std::wstring wide(length > 0 ? length : 1, L'\0');
    MultiByteToWideChar(CP_ACP, 0, text.c_str(), -1, wide.data(), length);
    wide.resize(wide.size() - 1);
    return wide;
}

// GDI leaves the fourth byte of each pixel 0; the PNG gets it as opaque alpha.
std::vector<std::uint32_t> OpaquePixels(const DibCanvas& canvas)
{
    GdiFlush();
    const size_t total = static_cast<size_t>(canvas.GetWidth()) * canvas.GetHeight();
    std::vector<std::uint32_t> pixels(canvas.GetBits(), canvas.GetBits() + total);
    for (std::uint32_t& pixel : pixels)
        pixel |= 0xFF000000u;
    return pixels;
}

} // namespace

std::string WritePng(const DibCanvas& canvas, const std::string& path)
{
    if (!canvas.IsValid())
        return "nothing to write: the canvas is empty";
    ComScope com;

    ComPtr<IWICImagingFactory> factory;
    HRESULT hr = CoCreateInstance(CLSID_WICImagingFactory, nullptr, CLSCTX_INPROC_SERVER,
                                  IID_PPV_ARGS(&factory));
    if (FAILED(hr))
        return Failure("creating the imaging factory", hr);

    ComPtr<IWICStream> stream;
    if (FAILED(hr = factory->CreateStream(&stream)))
        return Failure("creating a stream", hr);
    if (FAILED(hr = stream->InitializeFromFilename(Widen(path).c_str(), GENERIC_WRITE)))
        return Failure("opening the output file", hr);

    ComPtr<IWICBitmapEncoder> encoder;
    if (FAILED(hr = factory->CreateEncoder(GUID_ContainerFormatPng, nullptr, &encoder)))
        return Failure("creating the PNG encoder", hr);
    if (FAILED(hr = encoder->Initialize(stream.Get(), WICBitmapEncoderNoCache)))
        return Failure("starting the PNG encoder", hr);

    ComPtr<IWICBitmapFrameEncode> frame;
    if (FAILED(hr = encoder->CreateNewFrame(&frame, nullptr)))
        return Failure("creating the PNG frame", hr);
    if (FAILED(hr = frame->Initialize(nullptr)))
        return Failure("starting the PNG frame", hr);
    const UINT width = static_cast<UINT>(canvas.GetWidth());
    const UINT height = static_cast<UINT>(canvas.GetHeight());
    if (FAILED(hr = frame->SetSize(width, height)))
        return Failure("setting the picture size", hr);
    WICPixelFormatGUID format = GUID_WICPixelFormat32bppBGRA;
    if (FAILED(hr = frame->SetPixelFormat(&format)))
        return Failure("setting the pixel format", hr);
    if (format != GUID_WICPixelFormat32bppBGRA)
        return "the PNG encoder does not take 32-bit BGRA pixels";

    std::vector<std::uint32_t> pixels = OpaquePixels(canvas);
    const UINT stride = width * 4;
    if (FAILED(hr = frame->WritePixels(height, stride, stride * height, reinterpret_cast<BYTE*>(pixels.data()))))
        return Failure("writing the pixels", hr);
    if (FAILED(hr = frame->Commit()))
        return Failure("finishing the PNG frame", hr);
    if (FAILED(hr = encoder->Commit()))
        return Failure("finishing the PNG file", hr);
    return {};
}
