#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

// What a file says beyond its web: label lines and the numbers of its header, as pairs of a key and a text.

namespace OvPhotometrics {

/// Pairs in the order of their file. Keys of label lines are header keywords ("MANUFAC"), "line", "line 1",
/// "label 1" or "title"; every other key names a number or choice of the format.
class FileFacts {
public:
    struct Fact {
        std::wstring key;
        std::wstring text;
    };

    void add(std::wstring key, std::wstring text);
    /// The shortest text that reads back as the same number.
    void add(std::wstring key, std::int32_t value);
    void add(std::wstring key, float value);
    /// Numbers with one blank between them.
    void add(std::wstring key, std::span<const float> values);

    /// The text of the first fact of a key, or null.
    const std::wstring* find(std::wstring_view key) const;
    /// The number, or numbers, of a key. False, and nothing changed, where the key is missing or its text is not
    /// as many numbers.
    bool read(std::wstring_view key, std::int32_t& value) const;
    bool read(std::wstring_view key, float& value) const;
    bool read(std::wstring_view key, std::span<float> values) const;

    /// The label lines as texts that any format can take: "[MANUFAC] Acme" for a keyword's, else as it stands.
    /// None is empty, and control characters are blanks.
    std::vector<std::wstring> textLines() const;

    auto begin() const { return _facts.begin(); }
    auto end() const { return _facts.end(); }

private:
    std::vector<Fact> _facts;
};

/// `text` with blanks for control characters, at most `limit` characters long.
std::wstring labelText(std::wstring_view text, std::size_t limit);

}  // namespace OvPhotometrics
