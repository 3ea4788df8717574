// The version of the DLLs: each one's version resource, read back with the
// Win32 version API from the file the process loaded, carries the version of
// Tavo_WiVersion.h, names its own file and describes itself.
#include "Tavo_WiLibrary.h"
#include "Tavo_WiVersion.h"

#include <windows.h>

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

// The project's version as CMake knows it, to check the generated header by.
constexpr const char* kProjectVersion = TAVO_PROJECT_VERSION;

struct VersionResource
{
    VS_FIXEDFILEINFO fixed = {};
    std::vector<char> block;

    // A string of the US English, Unicode table; empty when there is none.
    std::string Text(const char* name)
    {
        const std::string path = std::string("\\StringFileInfo\\040904B0\\") + name;
        char* value = nullptr;
        UINT length = 0;
        if (!VerQueryValueA(block.data(), path.c_str(), reinterpret_cast<void**>(&value), &length) || value == nullptr)
            return {};
        return std::string(value);
    }
};

std::string LoadedPath(const char* dllName)
{
    char path[MAX_PATH] = {};
    const HMODULE module = GetModuleHandleA(dllName);
    if (module == nullptr || GetModuleFileNameA(module, path, MAX_PATH) == 0)
        return {};
    return path;
}

// False, with the reason noted by the test, when the file has no readable
// version resource.
bool ReadVersion(const std::string& path, VersionResource& out)
{
    DWORD handle = 0;
    const DWORD size = GetFileVersionInfoSizeA(path.c_str(), &handle);
    if (size == 0)
        return false;
    out.block.resize(size);
    if (!GetFileVersionInfoA(path.c_str(), 0, size, out.block.data()))
        return false;
    VS_FIXEDFILEINFO* fixed = nullptr;
    UINT length = 0;
    if (!VerQueryValueA(out.block.data(), "\\", reinterpret_cast<void**>(&fixed), &length) || length < sizeof(*fixed))
        return false;
    out.fixed = *fixed;
    return true;
}

constexpr DWORD kVersionHigh = MAKELONG(TAVO_VERSION_MINOR, TAVO_VERSION_MAJOR);
constexpr DWORD kVersionLow = MAKELONG(0, TAVO_VERSION_PATCH);

TEST(Version, TheGeneratedHeaderCarriesTheProjectVersion)
{
    EXPECT_STREQ(TAVO_VERSION_STRING, kProjectVersion);
    EXPECT_EQ(std::to_string(TAVO_VERSION_MAJOR) + "." + std::to_string(TAVO_VERSION_MINOR) + "." +
                  std::to_string(TAVO_VERSION_PATCH),
              kProjectVersion);
    EXPECT_EQ(TAVO_VERSION, TAVO_VERSION_MAJOR * 10000 + TAVO_VERSION_MINOR * 100 + TAVO_VERSION_PATCH);
}

TEST(Version, EachDllCarriesTheVersionItsNameAndADescription)
{
    // Linking the library loads all three.
    Tavo_WiLibrary::Initialize();
    for (const char* dll : {"afx.dll", "libTavo_Core.dll", "libTavo_Windows.dll"}) {
        SCOPED_TRACE(dll);
        const std::string path = LoadedPath(dll);
        ASSERT_FALSE(path.empty());
        VersionResource version;
        ASSERT_TRUE(ReadVersion(path, version)) << "no version resource in " << path;

        EXPECT_EQ(version.fixed.dwSignature, static_cast<DWORD>(VS_FFI_SIGNATURE));
        EXPECT_EQ(version.fixed.dwFileType, static_cast<DWORD>(VFT_DLL));
        EXPECT_EQ(version.fixed.dwFileVersionMS, kVersionHigh);
        EXPECT_EQ(version.fixed.dwFileVersionLS, kVersionLow);
        EXPECT_EQ(version.fixed.dwProductVersionMS, kVersionHigh);
        EXPECT_EQ(version.fixed.dwProductVersionLS, kVersionLow);

        EXPECT_EQ(version.Text("FileVersion"), TAVO_VERSION_STRING);
        EXPECT_EQ(version.Text("ProductVersion"), TAVO_VERSION_STRING);
        EXPECT_EQ(version.Text("ProductName"), "libTavo_Windows");
        EXPECT_EQ(version.Text("OriginalFilename"), dll);
        EXPECT_FALSE(version.Text("FileDescription").empty());
    }
    Tavo_WiLibrary::Terminate(false);
}

}  // namespace
