// Tavo_DxfWarnings: the warnings of one import, one per kind of problem.
//
// A drawing with ten thousand HATCH entities gets one warning saying so, not
// ten thousand: warnings with the same text are counted, and the first line
// is kept. At most `limit` distinct warnings are kept; the rest are counted.
#pragma once

#include "Tavo_DxfImport.h"

#include <string>
#include <unordered_map>
#include <vector>

class Tavo_DxfWarnings {
public:
    explicit Tavo_DxfWarnings(int limit) : m_limit(limit) {}

    void Add(int line, const std::string& text)
    {
        auto found = m_index.find(text);
        if (found != m_index.end()) {
            ++m_entries[found->second].count;
            return;
        }
        if (static_cast<int>(m_entries.size()) >= m_limit) {
            ++m_dropped;
            return;
        }
        m_index.emplace(text, m_entries.size());
        m_entries.push_back({line, text, 1});
    }

    // The warnings as the import result gives them.
    void Deliver(std::vector<Tavo_DxfMessage>& out, int& dropped) const
    {
        for (const Entry& entry : m_entries) {
            Tavo_DxfMessage message;
            message.line = entry.line;
            message.text = entry.text;
            if (entry.count > 1)
                message.text += " (" + std::to_string(entry.count) + " times, first at line " + std::to_string(entry.line) + ")";
            else if (entry.line > 0)
                message.text += " (line " + std::to_string(entry.line) + ")";
            out.push_back(std::move(message));
        }
        dropped = m_dropped;
    }

private:
    struct Entry {
        int line;
        std::string text;
        long long count;
    };

    int m_limit;
    int m_dropped = 0;
    std::vector<Entry> m_entries;
    std::unordered_map<std::string, size_t> m_index;
};
