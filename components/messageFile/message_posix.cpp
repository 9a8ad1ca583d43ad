#include <nl_types.h>

#include <algorithm>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <vector>

#include "components/messageFile/messageStore.h"
#include "components/support/path.h"
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
        read(in, headerSize);
        std::error_code error;
        const std::uintmax_t size = fs::file_size(path, error);
        if (isOurs() && !error && size > headerSize) read(in, static_cast<std::size_t>(size) - headerSize);
    }

    /// Whether texts are missing at the end. The C library maps a catalogue without finding this out: a text
    /// behind the end would be empty, or end the process. Files of another kind it refuses itself.
    bool isCutShort() const {
        if (_bytes.size() < headerSize) return true;
        if (!isOurs()) return false;
        const std::uint64_t rows = std::uint64_t{headerWord(1)} * headerWord(2);
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

    /// The header stands in the order of the machine that compiled it.
    std::uint32_t headerWord(std::size_t index) const {
        return word(0) == turnedMagic ? __builtin_bswap32(word(index)) : word(index);
    }

    bool isOurs() const { return _bytes.size() >= headerSize && headerWord(0) == magic; }

    void read(std::istream& in, std::size_t count) {
        const std::size_t before = _bytes.size();
        _bytes.resize(before + count);
        in.read(_bytes.data() + before, static_cast<std::streamsize>(count));
        _bytes.resize(before + static_cast<std::size_t>(in.gcount()));
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
