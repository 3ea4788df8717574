// ViewExport: writes what a drawing view shows to a PNG file: the view's
// drawing, drawn afresh through a GDI surface into a bitmap of the view's
// size with the view's own mapping, on the view's background.
#pragma once

#include <string>

class DrawingView;

// path: 8-bit, as the file dialog gives it. Empty on success, else why not.
std::string ExportViewPng(DrawingView& view, const std::string& path);
