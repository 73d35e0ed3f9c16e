#pragma once

#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <utility>

namespace Sarnik
{

/// Texts that replace the defaults of localised strings, by their keys ("$$$/Key/Of/It"). Empty unless somebody fills
/// it, before the first thread but the main one starts.
class CStringTable
{
public:
    static CStringTable &Global()
    {
        static CStringTable table;
        return table;
    }

    /// `text` may have control sequences, as defaults may.
    void Set(std::string key, std::string text) { texts[std::move(key)] = std::move(text); }
    void Clear() { texts.clear(); }
    /// Null where the default holds.
    const std::string *Find(std::string_view key) const
    {
        const auto found = texts.find(key);
        return found == texts.end() ? nullptr : &found->second;
    }

private:
    std::map<std::string, std::string, std::less<>> texts;
};

} // namespace Sarnik
