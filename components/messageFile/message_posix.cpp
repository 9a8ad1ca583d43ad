#include <nl_types.h>

#include <algorithm>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <vector>

#include "components/messageFile/messageStore.h"
#include "host/platform/path.h"
#include "host/sdk/util.h"

namespace Ov {

namespace {

namespace fs = std::filesystem;

constexpr int messageSet = 1;
constexpr unsigned highestId = 0xFFFF;  // as in any resource file

/// The layout of a compiled catalogue of the C library: three words (magic, rows, tables), the tables of {set,
/// message, offset} least significant byte first, the same once more with the bytes turned round, then the texts.
class CatalogueImage {
public:
    explicit CatalogueImage(const fs::path& path) {
        std::ifstream in(path, std::ios::binary);
        _bytes.assign(std::istreambuf_iterator<char>(in), {});
    }

    /// Whether texts are missing at the end. The C library maps a catalogue without finding this out: a text
    /// behind the end would be empty, or end the process. Files of another kind it refuses itself.
    bool isCutShort() const {
        if (_bytes.size() < headerSize) return true;
        const bool turned = word(0) == turnedMagic;
        if (!turned && word(0) != magic) return false;
        const std::uint64_t rows = std::uint64_t{size(1, turned)} * size(2, turned);
        if (rows == 0 || rows > _bytes.size() / (2 * rowSize)) return true;
        const std::uint64_t texts = headerSize + 2 * rows * rowSize;
        return texts >= _bytes.size() || lastOffset(rows) >= _bytes.size() - texts || _bytes.back() != '\0';
    }

private:
    static constexpr std::uint32_t magic = 0x960408DE;
    static constexpr std::uint32_t turnedMagic = 0xDE080496;
    static constexpr std::size_t wordSize = 4, rowSize = 3 * wordSize, headerSize = 3 * wordSize;

    std::uint32_t word(std::size_t index) const {
        std::uint32_t value = 0;
        for (std::size_t i = wordSize; i-- > 0;)
            value = value << 8 | static_cast<unsigned char>(_bytes[index * wordSize + i]);
        return value;
    }

    std::uint32_t size(std::size_t index, bool turned) const {
        return turned ? __builtin_bswap32(word(index)) : word(index);
    }

    std::uint32_t lastOffset(std::uint64_t rows) const {
        std::uint32_t last = 0;
        for (std::size_t row = 1; row <= rows; ++row) last = std::max(last, word(3 * row + 2));
        return last;
    }

    std::vector<char> _bytes;
};

/// The open catalogue, or null.
nl_catd openCatalogue(const fs::path& path) {
    std::error_code error;
    if (!fs::is_regular_file(path, error) || CatalogueImage(path).isCutShort()) return nullptr;
    // A name without a slash would be looked up along NLSPATH.
    const nl_catd catalogue = catopen((path.has_parent_path() ? path : "." / path).c_str(), 0);
    return catalogue == reinterpret_cast<nl_catd>(-1) ? nullptr : catalogue;
}

}  // namespace

std::unique_ptr<RnMessageFile::Store> RnMessageFile::Store::open(const std::wstring& fileName) {
    const fs::path path = nativePath(fileName);
    const std::wstring language = WendSDK::Util::language();
    nl_catd catalogue = nullptr;
    if (!language.empty()) catalogue = openCatalogue(path.parent_path() / nativePath(language) / path.filename());
    if (!catalogue) catalogue = openCatalogue(path);
    return std::unique_ptr<Store>(catalogue ? new Store(catalogue) : nullptr);
}

RnMessageFile::Store::~Store() { catclose(static_cast<nl_catd>(_catalogue)); }

std::wstring RnMessageFile::Store::text(unsigned id) const {
    if (id > highestId) return {};
    return fromUtf8(catgets(static_cast<nl_catd>(_catalogue), messageSet, static_cast<int>(id), ""));
}

}  // namespace Ov
