#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "host/componentManager/componentManager.h"
#include "ovphoto/photoFormat.h"

namespace OvTool {

/// A format of photometric files, as the builder of its webs tells it.
struct Format {
    std::string name;                             // "IES"
    std::string extension;                        // "ies", the first of those that it is imported from
    Ov::PhotoFormatTraits traits;                 // the usual ones where the builder tells none
    Ov::RnRef<Ov::RnComponentBuilder> described;  // the builder by its interfaces: this one,
    Ov::RnRef<Ov::RnImportBuilder> builder;       // that which imports,
    Ov::RnRef<Ov::RnPhotoFormat> own;             // and that which tells of the format; null where there is none
};

/// The formats of the loaded modules, the one to be asked first in front.
class Formats {
public:
    Formats() = default;
    explicit Formats(Ov::RnComponentManager& manager);

    /// By name, in any letter case; null for a name that is none.
    const Format* named(std::string_view name) const;
    /// By the extension of a path, in any letter case; null for another.
    const Format* ofExtension(const std::string& path) const;
    /// Of the webs that a builder of this class id makes; null for none.
    const Format* ofClass(const Ov::RnUid& classId) const;
    /// The first that accepts the content of the input; null where none does.
    const Format* recognise(Ov::RnBufferedIO& io) const;

    /// Their names, or extensions, between commas.
    std::string list(std::string Format::*text) const;

    auto begin() const { return _formats.begin(); }
    auto end() const { return _formats.end(); }

private:
    std::vector<Format> _formats;
};

}  // namespace OvTool
