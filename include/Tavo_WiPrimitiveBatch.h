// Tavo_WiPrimitiveBatch: fixed-capacity storage for primitives of one kind
// that the rendering surface collects before it emits them with few GDI calls.
//
// An element is ValuesPerElement consecutive values (points of a polyline, or
// one box), so a batch of polylines is a ready argument of PolyPolyline.
// The storage is allocated once, at construction; adding never allocates.
#pragma once

#include <memory>

template <class Value, int ValuesPerElement>
class Tavo_WiPrimitiveBatch {
public:
    explicit Tavo_WiPrimitiveBatch(int capacity)
        : m_elements(new Value[static_cast<size_t>(capacity) * ValuesPerElement]), m_capacity(capacity)
    {
    }

    Tavo_WiPrimitiveBatch(const Tavo_WiPrimitiveBatch&) = delete;
    Tavo_WiPrimitiveBatch& operator=(const Tavo_WiPrimitiveBatch&) = delete;

    // The next free element; the caller fills all its values, then checks
    // IsFull() and emits the batch when it is.
    Value* Append() { return &m_elements[static_cast<size_t>(m_count++) * ValuesPerElement]; }
    bool IsFull() const { return m_count == m_capacity; }
    bool IsEmpty() const { return m_count == 0; }

    const Value* GetElement(int index) const { return &m_elements[static_cast<size_t>(index) * ValuesPerElement]; }
    const Value* GetElements() const { return m_elements.get(); }

    std::unique_ptr<Value[]> m_elements;
    int m_count = 0;
    int m_capacity = 0;
};
