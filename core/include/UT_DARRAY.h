// UT_DARRAY: a growable array of fixed-width elements.
//
// The owner hands in the address of its own element pointer; the array keeps
// that pointer at the start of its storage whenever the storage moves, so the
// owner reads elements through a typed pointer of its own. Elements are raw
// bytes: the array never constructs or destroys what they hold, and its
// destructor releases only the storage.
//
//   UT_DARRAY(&m_entries, sizeof(Entry*), 20, 1)
//
// constructs an array of pointer-wide elements with room for 20 before the
// first growth, whose new elements start zeroed (clearNew 1). Growth doubles the
// capacity. Failing to grow leaves the array as it was.
#pragma once

#include "Tavo_CoreApi.h"

class TAVO_CORE_API UT_DARRAY {
public:
    UT_DARRAY(void* storagePointer, int elementWidth, int initialCapacity, int clearNew);
    virtual ~UT_DARRAY();
    UT_DARRAY(const UT_DARRAY&) = delete;
    UT_DARRAY& operator=(const UT_DARRAY&) = delete;

    // The number of elements.
    int getnum() const { return m_count; }
    int getwidth() const { return m_width; }

    // The address of element index. index == getnum() appends an element and
    // returns its address. Null for any other index outside 0 ... getnum() - 1,
    // or when the array cannot grow.
    virtual void* getaddr(int index);
    // Sets the number of elements: fewer drops the last ones, more appends (see
    // clearNew). Negative counts as 0. Returns false when the array cannot grow.
    virtual bool a_resetnum(int count);

private:
    bool Reserve(int capacity);
    // Writes the storage address into the owner's element pointer.
    void PublishStorage();

    void* m_storagePointer; // the owner's element pointer, kept in step
    char* m_storage = nullptr;
    int m_width;
    int m_count = 0;
    int m_capacity = 0;
    int m_initialCapacity;
    bool m_clearNew;
};
