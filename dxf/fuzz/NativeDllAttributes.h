// Forced into every source of the native build (-include): the core marks its
// classes for DLL export and import with __declspec, which means nothing in a
// program built in one piece on Linux.
#pragma once
#define __declspec(attribute)
