#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "components/photo/files/labelText.h"
#include "ovphoto/photoFormat.h"

// What a file says beyond its web: label lines and the numbers of its header, as pairs of a key and a text.

namespace OvPhotometrics {

using Ov::FactKind;
using Ov::FileFact;
using Ov::FileForm;

/// Facts in the order of their file. "encoding" ("UTF-8" or "Windows-1252") stands behind them where a label has more
/// than ASCII.
class FileFacts {
public:
    struct Fact {
        std::wstring key;
        std::wstring text;
        FactKind kind;
        std::size_t ownFrom;  // where the part of the text starts that FileFact::own is
    };

    FileFacts() = default;
    /// Those that a host gives.
    FileFacts(const FileFact* facts, std::int32_t count);

    /// Adds a line or choice. `usual` is the text of a value that says nothing; one of zeros alone never does.
    void add(std::wstring key, std::wstring text, FactKind kind, std::wstring_view usual = {});
    /// The shortest text that reads back as the same number.
    void add(std::wstring key, std::int32_t value, FactKind kind = FactKind::value, std::wstring_view usual = {});
    void add(std::wstring key, float value, FactKind kind = FactKind::value, std::wstring_view usual = {});
    /// Numbers with one blank between them, the first `ofLight` of which follow from the light.
    void add(std::wstring key, std::span<const float> values, std::wstring_view usual = {},
             std::size_t ofLight = 0);
    /// Makes of a value one that says nothing of its own.
    void disown(std::wstring_view key);

    /// The text of a label's bytes, see `textOfLabel`; their encoding is remembered.
    std::wstring decoded(std::wstring_view bytes, std::size_t limit = std::wstring::npos);
    /// Adds the encoding of what has been decoded: UTF-8 where any of it was that.
    void addEncoding();
    /// @{
    /// Bytes of a label in the encoding that these facts name, see `takeLabel`; without one in UTF-8.
    std::wstring take(std::wstring_view& text, std::size_t limit) const;
    std::wstring label(std::wstring_view text, std::size_t limit) const { return take(text, limit); }
    /// @}

    /// The text of the first fact of a key, or null.
    const std::wstring* find(std::wstring_view key) const;
    /// The number, or numbers, of a key. False, and nothing changed, where the key is missing or its text is not
    /// as many numbers.
    bool read(std::wstring_view key, std::int32_t& value) const;
    bool read(std::wstring_view key, float& value) const;
    bool read(std::wstring_view key, std::span<float> values) const;

    /// The label lines as texts that any format can take: "[MANUFAC] Acme" for a keyword's, "[BLOCK]" for one
    /// without a text, else as it stands. None is empty, and control characters are blanks.
    std::vector<std::wstring> textLines() const;

    /// As hosts take and give them; their texts are those of these facts.
    std::vector<FileFact> list() const;
    /// Visits them, until the visitor stops.
    void visit(Ov::RnEnumerator<const FileFact&>& visitor) const;

    auto begin() const { return _facts.begin(); }
    auto end() const { return _facts.end(); }

private:
    /// Adds a fact whose text says something of its own from `from` on, if at all.
    void append(std::wstring key, std::wstring text, FactKind kind, std::wstring_view usual, std::size_t from);

    std::vector<Fact> _facts;
    std::optional<LabelEncoding> _encoding;  // of what has been decoded
};

/// Whether one of the `textLines` is a keyword without a text.
bool isBareKeyword(std::wstring_view line);

}  // namespace OvPhotometrics
