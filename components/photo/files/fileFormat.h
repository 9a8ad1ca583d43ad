#pragma once

#include "components/photo/files/fileFacts.h"
#include "host/componentManager/builder.h"
#include "ovphoto/numberedExports.h"

namespace OvPhotometrics {

/// A file format as the numbered exports see it. The builder of every format's webs is one.
class FileFormat {
public:
    /// Keeps the position.
    virtual bool recognises(Ov::RnBufferedIO& io) = 0;
    /// Adds what a file says beyond its web. False after the messages of its reader.
    virtual bool readFacts(Ov::RnBufferedIO& io, const wchar_t* basePath, FileFacts& facts) = 0;
    /// As a builder's `import`, and adds what the file says beyond its web.
    virtual Ov::RnRef<Ov::RnCastable> importWithFacts(Ov::RnBufferedIO& io, const wchar_t* name,
                                                      const wchar_t* basePath, FileFacts& facts) = 0;
    /// False, and nothing has been written, after messages.
    virtual bool write(Ov::RnIntensityDist& dist, Ov::RnStream& out, FileForm form, const FileFacts& facts) = 0;

protected:
    ~FileFormat() = default;
};

/// The format of a builder's webs; null for a builder of other objects.
FileFormat* formatOf(Ov::RnComponentBuilder* builder);
/// The format that an importer takes an input for: of those that recognise it the first by its builder's name. Null
/// where there is none.
FileFormat* recognise(Ov::RnBufferedIO& io);

}  // namespace OvPhotometrics
