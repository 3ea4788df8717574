// The version of the DLLs: each one's version resource, read back with the
// Win32 version API from the file the process loaded, carries the project's
// version (the one Tavo_WiVersion.h holds), names its own file and describes
// itself.
#include "Tavo_WiLibrary.h"
#include "Tavo_WiVersion.h"

#include <windows.h>

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

std::string LoadedPath(const char* dllName)
{
    char path[MAX_PATH] = {};
    const HMODULE module = GetModuleHandleA(dllName);
    return module != nullptr && GetModuleFileNameA(module, path, MAX_PATH) != 0 ? path : "";
}

// A string of the US English, Unicode table of a version block; empty when
// there is none.
std::string VersionText(std::vector<char>& block, const std::string& name)
{
    char* value = nullptr;
    UINT length = 0;
    const std::string path = "\\StringFileInfo\\040904B0\\" + name;
    return VerQueryValueA(block.data(), path.c_str(), reinterpret_cast<void**>(&value), &length) && value != nullptr
        ? value
        : "";
}

TEST(Version, TheGeneratedHeaderCarriesTheProjectVersion)
{
    EXPECT_STREQ(TAVO_VERSION_STRING, TAVO_PROJECT_VERSION);
    EXPECT_EQ(std::to_string(TAVO_VERSION_MAJOR) + "." + std::to_string(TAVO_VERSION_MINOR) + "." +
                  std::to_string(TAVO_VERSION_PATCH),
              TAVO_PROJECT_VERSION);
}

TEST(Version, EachDllCarriesTheVersionItsNameAndADescription)
{
    Tavo_WiLibrary::Initialize(); // the first call into the library: all three DLLs are loaded
    const DWORD high = MAKELONG(TAVO_VERSION_MINOR, TAVO_VERSION_MAJOR);
    const DWORD low = MAKELONG(0, TAVO_VERSION_PATCH);
    for (const char* dll : {"afx.dll", "libTavo_Core.dll", "libTavo_Windows.dll"}) {
        SCOPED_TRACE(dll);
        const std::string path = LoadedPath(dll);
        DWORD handle = 0;
        std::vector<char> block(GetFileVersionInfoSizeA(path.c_str(), &handle));
        ASSERT_FALSE(block.empty()) << "no version resource in " << path;
        ASSERT_TRUE(GetFileVersionInfoA(path.c_str(), 0, static_cast<DWORD>(block.size()), block.data()));
        VS_FIXEDFILEINFO* fixed = nullptr;
        UINT length = 0;
        ASSERT_TRUE(VerQueryValueA(block.data(), "\\", reinterpret_cast<void**>(&fixed), &length));
        ASSERT_GE(length, sizeof(*fixed));

        EXPECT_EQ(fixed->dwSignature, static_cast<DWORD>(VS_FFI_SIGNATURE));
        EXPECT_EQ(fixed->dwFileType, static_cast<DWORD>(VFT_DLL));
        EXPECT_EQ(fixed->dwFileVersionMS, high);
        EXPECT_EQ(fixed->dwFileVersionLS, low);
        EXPECT_EQ(fixed->dwProductVersionMS, high);
        EXPECT_EQ(fixed->dwProductVersionLS, low);
        EXPECT_EQ(VersionText(block, "FileVersion"), TAVO_VERSION_STRING);
        EXPECT_EQ(VersionText(block, "ProductVersion"), TAVO_VERSION_STRING);
        EXPECT_EQ(VersionText(block, "ProductName"), "libTavo_Windows");
        EXPECT_EQ(VersionText(block, "OriginalFilename"), dll);
        EXPECT_FALSE(VersionText(block, "FileDescription").empty());
    }
    Tavo_WiLibrary::Terminate(false);
}

} // namespace
