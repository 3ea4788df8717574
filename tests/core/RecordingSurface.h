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
        std::string op;                   // "Dot", "Line", "BeginLayer", ...
        std::vector<Tavo_GrDPoint> points; // device points handed over (rect: 2 corners)
        int number = 0;                    // radius, font height or point count
        std::string text;
        char color = 0;
        bool hollow = false;
        double scale = 0.0;
        int deviceHeight = 0;
    };

    ~RecordingSurface() = default;

    // Only counts calls when false (for very large drawings).
    bool m_record = true;
    std::vector<Call> m_calls;
    int m_items = 0;       // drawing operations 3 ... 12 received
    int m_attrChanges = 0; // OnAttrChange calls
    int m_polls = 0;
    // PollDrawInterrupt reports an interrupt from this poll on (0: never).
    int m_interruptAtPoll = 0;

    std::vector<std::string> Ops() const
    {
        std::vector<std::string> ops;
        for (const Call& call : m_calls)
            ops.push_back(call.op);
        return ops;
    }
    int Count(const std::string& op) const
    {
        int n = 0;
        for (const Call& call : m_calls)
            n += call.op == op;
        return n;
    }

    void DrawCircle(Tavo_GrDPoint& centre, int radius, Tavo_GrAttr* attr) override
    {
        SetCurrentAttr(attr);
        Item("Circle", {centre}, radius);
    }
    void DrawDot(Tavo_GrDPoint& point, Tavo_GrAttr* attr) override
    {
        SetCurrentAttr(attr);
        Item("Dot", {point});
    }
    void DrawLine(Tavo_GrDPoint& from, Tavo_GrDPoint& to, Tavo_GrAttr* attr) override
    {
        SetCurrentAttr(attr);
        Item("Line", {from, to});
    }
    void DrawPline(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr) override
    {
        SetCurrentAttr(attr);
        Item("Pline", std::vector<Tavo_GrDPoint>(points, points + count), count);
    }
    void DrawRect(Tavo_GrDRect& rect, Tavo_GrAttr* attr) override
    {
        SetCurrentAttr(attr);
        Item("Rect", {{rect.xmin, rect.ymin}, {rect.xmax, rect.ymax}});
    }
    void DrawText(const char* text, Tavo_GrDRect& box, Tavo_GrAttr* attr, unsigned int fontHeight) override
    {
        SetCurrentAttr(attr);
        Item("TextBox", {{box.xmin, box.ymin}, {box.xmax, box.ymax}}, static_cast<int>(fontHeight), text);
    }
    void DrawText(const char* text, Tavo_GrDPoint& point, Tavo_GrAttr* attr) override
    {
        SetCurrentAttr(attr);
        Item("Text", {point}, 0, text);
    }
    void DrawTriangle(Tavo_GrDPoint points[3], Tavo_GrAttr* attr) override
    {
        SetCurrentAttr(attr);
        Item("Triangle", {points[0], points[1], points[2]});
    }
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
        ++m_polls;
        if (m_interruptAtPoll > 0 && m_polls >= m_interruptAtPoll)
            SetDrawingInterruptedFlag();
        return Tavo_GrSurface::PollDrawInterrupt();
    }

private:
    void Note(const char* op)
    {
        Call call;
        call.op = op;
        m_calls.push_back(call);
    }
    void Item(const char* op, std::vector<Tavo_GrDPoint> points, int number = 0, const char* text = "")
    {
        ++m_items;
        if (!m_record)
            return;
        Call call;
        call.op = op;
        call.points = std::move(points);
        call.number = number;
        call.text = text ? text : "";
        call.color = GetCurrentColor();
        call.hollow = IsHollow();
        call.scale = GetScale();
        call.deviceHeight = GetDeviceHeight();
        m_calls.push_back(call);
    }
};

#pragma pop_macro("DrawText")
