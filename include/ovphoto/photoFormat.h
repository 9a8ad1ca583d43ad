#pragma once

#include <cstdint>

#include "host/componentManager/builder.h"
#include "host/componentManager/stream.h"
#include "ovphoto/intensityDist.h"

// File formats of luminaires: what each is like, and what their files say beyond the webs.

namespace Ov {

/// What the values of a format's files are.
enum class PhotoValueUnit : std::int32_t {
    candela = 0,             ///< candela, with the factors of the file
    candelaPerKilolumen = 1  ///< candela for every 1000 lm, or other reference, of the lamps' lumens
};

/// Which angles the grids of a format can have.
enum class PhotoGrids : std::int32_t {
    any = 0,  ///< any that ascend
    even = 1  ///< those with even steps
};

/// What a file format is like. The same for all of its files.
struct PhotoFormatTraits {
    /// For people, and what they ask for it by: "IES". In capitals.
    const wchar_t* name = L"";
    /// The place in which it is asked whether an input is its own: lower numbers first. Below 500 stand formats with a
    /// signature, above it those that are told by their structure, and that a text of numbers may be.
    int preference = 500;
    /// What its values are.
    PhotoValueUnit unit = PhotoValueUnit::candela;
    /// Which angles its files can have.
    PhotoGrids grids = PhotoGrids::any;
    /// Whether its files say what the lamps give off, be it any number of lumens.
    bool holdsLampLumens = false;
    /// Whether its files say how the light is turned, so that its webs can be saved faithfully
    /// (ovphoto/saveForm.h).
    bool holdsOrientation = false;
    /// Whether its reader's messages name the line.
    bool namesLines = false;
    /// @{
    /// What its builder can do: tell what a file says beyond its web; write one, in either form.
    bool readsFacts = false;
    bool writes = false;
    /// @}
};

/// What a distribution is written as.
enum class FileForm : std::int32_t {
    /// What a web of the format saves into a host's stream: relative values in some formats, grids that do not fit
    /// sampled coarsely in the web's own frame, orientations dropped. Facts are not used.
    asSaved = 0,
    /// A file that is right in other programs: absolute candela, or what the format has, with six digits or more
    /// where the format has decimals. The grid is the web's own, orientation included, where the format can hold it;
    /// else the distribution in the host frame on even planes, with steps of the web's smallest, 1 degree at the
    /// least or finer for narrow beams, that lose less than 0.1 % of the peak where they can. What is written has been
    /// read back by the format's own reader.
    faithful = 1
};

/// What one thing that a file says is about.
enum class FactKind : std::int32_t {
    label = 0,    ///< a line of text, named by its place
    keyword = 1,  ///< a line of text, named by its keyword
    value = 2,    ///< a number or choice beside the light
    ofLight = 3,  ///< a number or choice that follows from the light
    factor = 4    ///< a number that all values are multiplied by, so that it is in the light
};

/// One thing that a file says beyond its web; docs/formats/facts.md lists the keys of each format. Label lines come
/// first and, where labels hold more than ASCII, "encoding" last: "UTF-8" or "Windows-1252". A label whose bytes are
/// UTF-8 is that text, all others are Windows-1252. Labels are written in the encoding that the facts name, or in UTF-8.
///
/// Numbers are the shortest text that reads back as the same value, several with one blank between them.
struct FileFact {
    FactKind kind;        ///< what it is about
    const wchar_t* key;   ///< which
    const wchar_t* text;  ///< what the file says
    /// The part of the text, its end, that is lost where another file does not hold it: all of a label; nothing of what
    /// follows from the light or stands in a file for want of anything to say. Writers do not look at it.
    const wchar_t* own = L"";
};

/// What the builder of a format's webs answers beside RnImportBuilder.
///
/// Threads:  as for RnImportBuilder, each with streams, devices and visitors of its own.
class RnPhotoFormat : public RnImportBuilder {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x7c1e9f21, 0x4a5b11ef, 0x9c6e0b62, 0x5d83a4f7};

    /// The same for all files.
    virtual PhotoFormatTraits getTraits() const = 0;

    /// Reads an input and visits what it says beyond its web, label lines first, each in the order of the file.
    /// `basePath` (may be null) is where a file that this one needs is looked for first. The texts are valid during the
    /// visit. False, and nothing has been visited, when the input is refused, after messages.
    virtual bool readFacts(RnBufferedIO& io, const wchar_t* basePath, RnEnumerator<const FileFact&>& visitor) = 0;

    /// Both in one reading: imports a web as `import` does, which raises RnStreamEx::ExReadError where it refuses, and
    /// then visits what the file says beyond it. `name`, which becomes the web's, and `basePath` may be null.
    virtual RnRef<RnCastable> importWithFacts(RnBufferedIO& io, const wchar_t* name, const wchar_t* basePath,
                                              RnEnumerator<const FileFact&>& visitor) = 0;

    /// Writes any distribution as the text of a file to a text stream. A faithful file takes its label lines, and
    /// those of the format's own numbers that do not follow from the light, from `count` facts as `readFacts` gives
    /// them, of any format: lines of another format go where there is room, keywords in front; the name of a web
    /// distribution's web goes where no fact says what the luminaire is. A text that would make an importer take the
    /// file for one of another format is written behind a blank, after a message.
    /// False, and nothing has been written, after messages to the host's reporter, message 13084 where the format is
    /// only read; a stream that fails raises RnStreamEx. Some formats, in the form that is saved, raise ExBadCast for
    /// a web distribution without a web.
    virtual bool write(RnIntensityDist& distribution, RnStream& out, FileForm form, const FileFact* facts,
                       std::int32_t count) = 0;
};

}  // namespace Ov
