// Registers a PostScript printer inside the Wine prefix and makes it the
// default, so that the print dialog returns a real printer device context
// without any print server running.
//
//   wine_printer_setup <printer name> <PPD file, Windows path>
//
// The printer prints to the FILE: port; programs give DOCINFO.lpszOutput.
// Exit status 0 when the printer exists and is the default afterwards.
#include <windows.h>
#include <winspool.h>
#include <cstdio>

int main(int argc, char** argv)
{
    if (argc != 3) {
        std::fprintf(stderr, "usage: wine_printer_setup <printer name> <ppd path>\n");
        return 2;
    }
    char* name = argv[1];
    char* ppd = argv[2];

    DRIVER_INFO_3A driver = {};
    driver.cVersion = 3;
    driver.pName = name;
    driver.pDriverPath = const_cast<char*>("wineps.drv");
    driver.pDataFile = ppd;
    driver.pConfigFile = const_cast<char*>("wineps.drv");
    if (!AddPrinterDriverExA(nullptr, 3, reinterpret_cast<BYTE*>(&driver),
                             APD_COPY_NEW_FILES | APD_COPY_FROM_DIRECTORY)) {
        std::fprintf(stderr, "AddPrinterDriverEx failed: %lu\n", GetLastError());
        return 1;
    }

    HANDLE existing = nullptr;
    if (OpenPrinterA(name, &existing, nullptr)) {
        ClosePrinter(existing);
    } else {
        PRINTER_INFO_2A printer = {};
        printer.pPrinterName = name;
        printer.pPortName = const_cast<char*>("FILE:");
        printer.pDriverName = name;
        printer.pPrintProcessor = const_cast<char*>("WinPrint");
        printer.pDatatype = const_cast<char*>("RAW");
        printer.Attributes = PRINTER_ATTRIBUTE_LOCAL;
        HANDLE added = AddPrinterA(nullptr, 2, reinterpret_cast<BYTE*>(&printer));
        if (!added) {
            std::fprintf(stderr, "AddPrinter failed: %lu\n", GetLastError());
            return 1;
        }
        ClosePrinter(added);
    }

    if (!SetDefaultPrinterA(name)) {
        std::fprintf(stderr, "SetDefaultPrinter failed: %lu\n", GetLastError());
        return 1;
    }
    std::printf("default printer: %s\n", name);
    return 0;
}
