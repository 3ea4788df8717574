// The built-in sample drawing of the render program: every primitive kind,
// the sixteen built-in colours, outlined and filled shapes, and text of
// several sizes and alignments, laid out in labelled panels.
#pragma once

class Tavo_GrDrawing;

// World size of the sample, in world units (y up from the bottom edge).
constexpr int kSampleWidth = 1600;
constexpr int kSampleHeight = 1000;

// Fills an empty drawing with the sample.
void BuildSampleDrawing(Tavo_GrDrawing& drawing);
