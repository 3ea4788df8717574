// dxf_fuzz: libFuzzer entry point. Each input is imported as a DXF file and,
// when it imports, drawn. Limits are lowered so that a single input cannot
// take long: the fuzzer looks for crashes, hangs and leaks, not for big
// drawings.
#include "NativeImport.h"

#include <cstdint>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    Tavo_DxfLimits limits;
    limits.maxItems = 100000;
    limits.maxPoints = 1000000;
    limits.maxTextBytes = 1000000;
    limits.maxWork = 300000;
    ImportAndDraw(reinterpret_cast<const char*>(data), size, limits);
    return 0;
}
