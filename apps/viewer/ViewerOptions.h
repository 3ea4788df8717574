// ViewerOptions: the viewer's command line.
//
//   viewer [FILE]                 shows FILE (or the built-in sample)
//   viewer --tour OUTDIR FILE     runs the scripted tour on FILE, writing its
//                                 pictures and print job into OUTDIR
//   viewer --help
#pragma once

#include <string>

struct ViewerOptions {
    std::string file;       // a Windows path; empty: the built-in sample
    std::string tourFolder; // set: run the tour, its pictures go here
    bool help = false;
};

// Parses argv[1 ...]; false with error set for a command line it does not know.
bool ParseViewerOptions(int argc, char** argv, ViewerOptions& options, std::string& error);

const char* ViewerUsage();
