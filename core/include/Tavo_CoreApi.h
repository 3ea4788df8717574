// TAVO_CORE_API: marks the classes and functions that libTavo_Core.dll
// exports. The DLL itself is compiled with TAVO_CORE_BUILD defined; its users
// import.
#pragma once

#if defined(TAVO_CORE_BUILD)
#define TAVO_CORE_API __declspec(dllexport)
#else
#define TAVO_CORE_API __declspec(dllimport)
#endif
