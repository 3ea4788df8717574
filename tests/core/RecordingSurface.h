// RecordingSurface: a surface for tests that writes down every call the
// graphics core makes on it, in order, with the base state seen at the time.
#pragma once

#include "Tavo_GrSurface.h"

#include <string>
#include <vector>

#pragma push_macro("DrawText")
#undef DrawText

class RecordingSurface : public Tavo_GrSurface {
public:
    struct Call {
        std::string op;                    // "Dot", "Line", "BeginLayer", ...
        std::vector<Tavo_GrDPoint> points; // device points handed over (rect: 2 corners)
        int number = 0;                    // radius or font height
        std::string text;
        char color = 0;
        bool hollow = false;
        double scale = 0.0;
        int deviceHeight = 0;
    };

    std::vector<Call> m_calls;
    int m_items = 0; // drawing operations received
    int m_attrChanges = 0;
    int m_interruptAtPoll = 0;    // PollDrawInterrupt reports an interrupt from this poll on (0: never)
    int m_interruptAfterItem = 0; // the surface sets the interrupted flag itself after this item (0: never)

    // The operations received, separated by spaces, leaving out those named skip.
    std::string Ops(const std::string& skip = "") const
    {
        std::string ops;
        for (const Call& call : m_calls)
            if (call.op != skip)
                ops += (ops.empty() ? "" : " ") + call.op;
        return ops;
    }

    void DrawCircle(Tavo_GrDPoint& centre, int radius, Tavo_GrAttr* attr) override { Item(attr, "Circle", {centre}, radius); }
    void DrawDot(Tavo_GrDPoint& point, Tavo_GrAttr* attr) override { Item(attr, "Dot", {point}); }
    void DrawLine(Tavo_GrDPoint& from, Tavo_GrDPoint& to, Tavo_GrAttr* attr) override { Item(attr, "Line", {from, to}); }
    void DrawPline(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr) override { Item(attr, "Pline", {points, points + count}); }
    void DrawRect(Tavo_GrDRect& rect, Tavo_GrAttr* attr) override { Item(attr, "Rect", Corners(rect)); }
    void DrawText(const char* text, Tavo_GrDRect& box, Tavo_GrAttr* attr, unsigned int fontHeight) override
    {
        Item(attr, "TextBox", Corners(box), static_cast<int>(fontHeight), text);
    }
    void DrawText(const char* text, Tavo_GrDPoint& point, Tavo_GrAttr* attr) override { Item(attr, "Text", {point}, 0, text); }
    void DrawTriangle(Tavo_GrDPoint p[3], Tavo_GrAttr* attr) override { Item(attr, "Triangle", {p[0], p[1], p[2]}); }

    void Flush() override
    {
        Tavo_GrSurface::Flush();
        Note("Flush");
    }
    void OnAttrChange() override
    {
        Tavo_GrSurface::OnAttrChange();
        ++m_attrChanges;
    }
    void BeginDrawing(const Tavo_GrDrawing* drawing) override
    {
        Tavo_GrSurface::BeginDrawing(drawing);
        Note("BeginDrawing");
    }
    void EndDrawing() override
    {
        Tavo_GrSurface::EndDrawing();
        Note("EndDrawing");
    }
    void BeginLayer(const Tavo_GrLayer* layer) override
    {
        Tavo_GrSurface::BeginLayer(layer);
        Note("BeginLayer");
    }
    void EndLayer() override
    {
        Tavo_GrSurface::EndLayer();
        Note("EndLayer");
    }
    bool PollDrawInterrupt() override
    {
        if (++m_polls >= m_interruptAtPoll && m_interruptAtPoll > 0)
            SetDrawingInterruptedFlag();
        return Tavo_GrSurface::PollDrawInterrupt();
    }

private:
    int m_polls = 0;

    static std::vector<Tavo_GrDPoint> Corners(const Tavo_GrDRect& r) { return {{r.xmin, r.ymin}, {r.xmax, r.ymax}}; }
    void Note(const char* op, std::vector<Tavo_GrDPoint> points = {}, int number = 0, const char* text = "")
    {
        m_calls.push_back({op, std::move(points), number, text ? text : "", GetCurrentColor(), IsHollow(), GetScale(),
                           GetDeviceHeight()});
    }
    void Item(Tavo_GrAttr* attr, const char* op, std::vector<Tavo_GrDPoint> points, int number = 0, const char* text = "")
    {
        SetCurrentAttr(attr);
        ++m_items;
        Note(op, std::move(points), number, text);
        if (m_items == m_interruptAfterItem)
            SetDrawingInterruptedFlag();
    }
};

#pragma pop_macro("DrawText")
