#include "components/messageFile/resourceCheck_windows.h"

#include <windows.h>

#include <algorithm>

namespace Ov {

namespace {

/// The section of the resources. Offsets count from its start, but those of the data from that of the image.
class ResourceSection {
public:
    ResourceSection(const char* image, const IMAGE_SECTION_HEADER& section)
        : _bytes(image + section.VirtualAddress),
          _address(section.VirtualAddress),
          _size(std::min(section.Misc.VirtualSize, section.SizeOfRawData)) {}

    /// `depth`: 0 for the table of types, 1 for that of a type's names, 2 for that of a name's languages.
    bool isTableSound(DWORD offset, int depth = 0, bool ofStrings = false) const {
        const auto* const table = at<IMAGE_RESOURCE_DIRECTORY>(offset);
        if (!table) return false;
        const DWORD first = offset + sizeof *table;
        const DWORD count = DWORD{table->NumberOfNamedEntries} + table->NumberOfIdEntries;
        for (DWORD i = 0; i < count; ++i) {
            const auto* const entry =
                at<IMAGE_RESOURCE_DIRECTORY_ENTRY>(first + i * DWORD{sizeof(IMAGE_RESOURCE_DIRECTORY_ENTRY)});
            if (!entry || !isEntrySound(*entry, depth, ofStrings)) return false;
        }
        return true;
    }

private:
    static constexpr int stringsInBlock = 16;

    template <class T>
    const T* at(DWORD offset) const {
        const bool inside = offset <= _size && sizeof(T) <= _size - offset;
        return inside ? reinterpret_cast<const T*>(_bytes + offset) : nullptr;
    }

    bool isEntrySound(const IMAGE_RESOURCE_DIRECTORY_ENTRY& entry, int depth, bool ofStrings) const {
        if (entry.NameIsString && textEnd(entry.NameOffset, _size) == 0) return false;
        if (depth == 2) return !entry.DataIsDirectory && isDataSound(entry.OffsetToData, ofStrings);
        const bool strings = depth == 0 ? entry.Name == reinterpret_cast<ULONG_PTR>(RT_STRING) : ofStrings;
        return entry.DataIsDirectory && isTableSound(entry.OffsetToDirectory, depth + 1, strings);
    }

    bool isDataSound(DWORD offset, bool isStrings) const {
        const auto* const data = at<IMAGE_RESOURCE_DATA_ENTRY>(offset);
        if (!data || data->OffsetToData < _address) return false;
        DWORD place = data->OffsetToData - _address;
        if (place > _size || data->Size > _size - place) return false;
        const DWORD end = place + data->Size;
        for (int i = 0; isStrings && i < stringsInBlock; ++i) {
            place = textEnd(place, end);
            if (place == 0) return false;
        }
        return true;
    }

    /// The end of a text that stands behind its length; 0 where it goes beyond `limit`.
    DWORD textEnd(DWORD offset, DWORD limit) const {
        const auto* const length = at<WORD>(offset);
        if (!length || offset + sizeof *length + *length * sizeof(wchar_t) > limit) return 0;
        return offset + DWORD{sizeof *length} + *length * DWORD{sizeof(wchar_t)};
    }

    const char* _bytes;
    DWORD _address;
    DWORD _size;
};

}  // namespace

bool resourcesAreSound(const void* image, std::uintmax_t fileSize) {
    const auto* const bytes = static_cast<const char*>(image);
    const auto* const start = reinterpret_cast<const IMAGE_DOS_HEADER*>(bytes);
    const auto* const headers = reinterpret_cast<const IMAGE_NT_HEADERS*>(bytes + start->e_lfanew);
    const DWORD table = headers->OptionalHeader.DataDirectory[IMAGE_DIRECTORY_ENTRY_RESOURCE].VirtualAddress;
    const IMAGE_SECTION_HEADER* const first = IMAGE_FIRST_SECTION(headers);
    const IMAGE_SECTION_HEADER* const end = first + headers->FileHeader.NumberOfSections;
    const auto* const section = std::find_if(first, end, [table](const auto& s) {
        return table >= s.VirtualAddress && table - s.VirtualAddress < s.SizeOfRawData;
    });
    // Tables refer to each other by their distance from the first, which is where the section starts.
    return section != end && table == section->VirtualAddress &&
           std::uintmax_t{section->PointerToRawData} + section->SizeOfRawData <= fileSize &&
           ResourceSection(bytes, *section).isTableSound(0);
}

}  // namespace Ov
