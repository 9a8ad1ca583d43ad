#pragma once

#include <span>

#include "components/messageFile/messageIds.h"
#include "components/photo/files/fileFacts.h"
#include "components/photo/files/numberText.h"
#include "components/photo/files/recognition.h"
#include "components/photo/files/savedWeb.h"
#include "components/photo/files/webDistribution.h"
#include "components/photo/lid/gridEvaluation.h"
#include "components/photo/lid/lidBuilder.h"
#include "components/photo/lid/photoWeb.h"
#include "components/photo/lid/reportMessage.h"
#include "components/photo/lid/webEvaluation.h"
#include "components/photo/lid/withinMemory.h"
#include "components/support/castImpl.h"
#include "components/support/devices.h"
#include "host/componentManager/stream.h"

// A file format as a component, written once: web class, persistence adapter and builder. A format gives its facts
// and functions in a struct:
//
//     struct IesFormat {
//         using Web = PhotoWebIES;               // final, derived from PhotoWebOf<PhotoWebIES, IesFormat>
//         using Record = IesFileRecord;          // the file as plain values; owns its parts
//         static constexpr BuilderInfo info;   // class id and texts
//         static constexpr PhotoFormatTraits traits;  // what its files are like; the builder adds what it can do
//         static constexpr const wchar_t* extension;
//         static constexpr const char* source;   // what stream exceptions carry: source path, lines, stream name
//         static constexpr int saveLine, loadLine;
//         static constexpr const char* streamName;
//         static bool canImport(RnBufferedIO&);  // content test; keeps the position
//         // These two may do without `basePath`, the folder of the file.
//         static bool read(Record&, RnStream&, const wchar_t* basePath);
//         static bool toWeb(const Record&, Web&, bool loaded, const wchar_t* name, const wchar_t* basePath);
//         // The facts that a record holds beyond its web. A format may go without.
//         static void describe(const Record&, FileFacts&);
//         // All that follows is of formats that are written, too.
//         static bool fromDistribution(RnIntensityDist&, Record&);
//         static bool write(const Record&, RnStream&, FileForm);  // or without a form, where it makes no odds
//         // For files that other programs read: a record with absolute candela, and the facts and name that it
//         // takes over.
//         static bool fromDistributionFaithfully(RnIntensityDist&, Record&);
//         static void carry(const FileFacts&, const std::wstring& name, Record&);
//         // Of a format whose texts can make its file look like one of another: these texts, as bytes, and how many
//         // bytes one takes.
//         static std::span<std::wstring> texts(Record&);
//         static constexpr std::size_t textLimit;
//     };
//
// The functions report what is wrong and answer false; the adapter turns that into the stream exception.

namespace OvPhotometrics {

template <class Format>
class PhotoWebPersistant;

template <class Format>
constexpr bool isDescribed = requires {
    Format::describe;
};
template <class Format>
constexpr bool isWritten = requires {
    Format::write;
};

/// False, after the message that files of the format are not written.
template <class Format>
bool reportOnlyRead() {
    reportMessage(messages::formatOnlyRead, Format::traits.name);
    return false;
}

template <class Format>
bool readRecord(typename Format::Record& record, Ov::RnStream& in, const wchar_t* basePath) {
    if constexpr (requires { Format::read(record, in, basePath); })
        return Format::read(record, in, basePath);
    else
        return Format::read(record, in);
}

template <class Format>
bool recordToWeb(const typename Format::Record& record, typename Format::Web& web, const wchar_t* name,
                 const wchar_t* basePath) {
    if constexpr (requires { Format::toWeb(record, web, true, name, basePath); })
        return Format::toWeb(record, web, true, name, basePath);
    else
        return Format::toWeb(record, web, true, name);
}

template <class Format>
bool writeRecord(const typename Format::Record& record, Ov::RnStream& out, FileForm form) {
    if constexpr (requires { Format::write(record, out, form); })
        return Format::write(record, out, form);
    else
        return Format::write(record, out);
}

/// Reads a text into `record` and makes it the content of `web`. Raises ExReadError where either is refused.
template <class Format>
void loadWeb(typename Format::Record& record, Ov::RnStream& in, typename Format::Web& web, const wchar_t* name,
             const wchar_t* basePath) {
    if (!readRecord<Format>(record, in, basePath) || !recordToWeb<Format>(record, web, name, basePath))
        throw Ov::RnStreamEx::ExReadError(Format::source, Format::loadLine, Format::streamName);
}

/// A record's text, to be read from its start; null after messages.
template <class Format>
RnRef<Ov::RnMemoryBuffer> textOfRecord(const typename Format::Record& record, FileForm form) {
    auto text = Ov::rnCreate<Ov::RnMemoryBuffer>();
    Ov::RnStream stream(text.get(), Ov::RnStream::Form::text);
    if (!writeRecord<Format>(record, stream, form)) return {};
    text->seek(0, 0);
    return text;
}

/// The web that the format's reader makes of a file; null after messages.
template <class Format>
RnRef<typename Format::Web> webOfText(Ov::RnBufferedIO& text) {
    Ov::RnStream stream(&text, Ov::RnStream::Form::text);
    typename Format::Record record;
    auto web = Ov::rnCreate<typename Format::Web>();
    const bool well =
        readRecord<Format>(record, stream, nullptr) && recordToWeb<Format>(record, *web, L"", nullptr);
    return well ? web : RnRef<typename Format::Web>();
}

/// Base of a format's web class `Self`.
template <class Self, class Format>
class PhotoWebOf : public Ov::RnDataObject<Self, PhotoWebPersistant<Format>, RnBasePhotoWebData,
                                           Ov::RnPhotoFileWeb, Ov::RnPhotoWebData, RnBasePhotoWebData> {
public:
    static constexpr BuilderInfo info = Format::info;
    static constexpr Ov::RnUid classId = Format::info.classId;

    RnRef<Ov::RnPhotoWebData> clone() const override { return Ov::rnCreate<Self>(self()); }
    // The shared evaluation: of one direction with this class's own queries, of many straight from the grid. A
    // class that overrides a query gives its own `getIntensities` too.
    float getIntensity(float theta, float psi) const override { return evaluateWeb(self(), theta, psi); }
    void getIntensities(const float* angles, std::size_t count, float* out) const override {
        evaluateGrid(this->grid(), angles, count, out);
    }

private:
    const Self& self() const { return static_cast<const Self&>(*this); }
};

/// Saves a web as its format's text, faithfully where that is set (ovphoto/saveForm.h), and loads it from there, on any
/// kind of stream.
template <class Format>
class PhotoWebPersistant final : public Ov::RnTempObject<typename Format::Web> {
public:
    using Ov::RnTempObject<typename Format::Web>::RnTempObject;

    void save(Ov::RnStream& out) override {
        if (!write(out)) throw Ov::RnStreamEx::ExWriteError(Format::source, Format::saveLine, Format::streamName);
    }

    bool load(Ov::RnStream& in, int, const wchar_t* name, const wchar_t* basePath) override {
        Record record;
        loadWeb<Format>(record, in, this->data(), name, basePath);
        return true;
    }

private:
    using Record = typename Format::Record;

    /// False after a message.
    bool write(Ov::RnStream& out) {
        if constexpr (isWritten<Format>) {
            const auto distribution = makeWebDistribution(this->data());
            const bool isFaithful = Format::traits.holdsOrientation && websAreSavedFaithfully();
            Record record;
            return (isFaithful ? takeFaithfully(*distribution, record)
                               : Format::fromDistribution(*distribution, record)) &&
                   writeRecord<Format>(record, out, isFaithful ? FileForm::faithful : FileForm::asSaved);
        } else {
            return reportOnlyRead<Format>();
        }
    }

    /// False after a message, also where the light would not come back the same.
    bool takeFaithfully(Ov::RnWebIntensityDist& distribution, Record& record) {
        const auto& web = this->data();
        distribution.setPeakIntensity(web.getMaxCandela());  // what its lumens give only if they are above 0
        if (!Format::fromDistributionFaithfully(distribution, record)) return false;
        const auto text = textOfRecord<Format>(record, FileForm::faithful);
        const auto again = text ? webOfText<Format>(*text) : RnRef<typename Format::Web>();
        if (again && keepsLight(web, *again)) return true;
        reportMessage(messages::webNotSaved, web.getName());
        return false;
    }
};

/// Builds webs of a format, imports them, and tells what the format is like.
template <class Format>
class PhotoWebBuilder final
    : public InfoBuilder<typename Format::Web, Ov::RnCastImpl2<LidBuilder, Ov::RnPhotoFormat, Ov::RnImportBuilder,
                                                               Ov::RnComponentBuilder, Ov::RnBuilderDescription>> {
public:
    using Ov::RnImportBuilder::canImport;
    using Ov::RnImportBuilder::import;

    Ov::PhotoFormatTraits getTraits() const override {
        Ov::PhotoFormatTraits traits = Format::traits;
        traits.readsFacts = isDescribed<Format>;
        traits.writes = isWritten<Format>;
        return traits;
    }

    RnEnum::Action enumerateExtensions(Ov::RnEnumerator<const wchar_t*>& visitor) override {
        const auto action = visitor.visit(Format::extension);
        return action != RnEnum::goOn ? action : visitor.finish();
    }

    bool canImport(Ov::RnBufferedIO* io) override { return Format::canImport(*Ov::rnCast<Ov::RnBufferedIO>(io)); }

    RnRef<Ov::RnCastable> import(Ov::RnPtr<Ov::RnBufferedIO> io, const wchar_t* name,
                                 const wchar_t* basePath) override {
        Ov::RnPostLoadList postLoad;
        Ov::RnStream stream(Ov::rnCast<Ov::RnBufferedIO>(io.get()).get(), Ov::RnStream::Form::text, &postLoad);
        const auto web = Ov::rnCreate<typename Format::Web>();
        Ov::rnCast<Ov::RnPersistant>(web.get())->load(stream, 0, name, basePath);
        postLoad.finish();
        return web;
    }

    bool readFacts(Ov::RnBufferedIO& io, const wchar_t* basePath,
                   Ov::RnEnumerator<const FileFact&>& visitor) override {
        Ov::RnStream stream(&io, Ov::RnStream::Form::text);
        Record record;
        if (!readRecord<Format>(record, stream, basePath)) return false;
        factsOf(record).visit(visitor);
        return true;
    }

    RnRef<Ov::RnCastable> importWithFacts(Ov::RnBufferedIO& io, const wchar_t* name, const wchar_t* basePath,
                                          Ov::RnEnumerator<const FileFact&>& visitor) override {
        Ov::RnStream stream(&io, Ov::RnStream::Form::text);
        Record record;
        const auto web = Ov::rnCreate<typename Format::Web>();
        loadWeb<Format>(record, stream, *web, name, basePath);
        factsOf(record).visit(visitor);
        return web;
    }

    bool write(Ov::RnIntensityDist& dist, Ov::RnStream& out, FileForm form, const FileFact* facts,
               std::int32_t count) override {
        if constexpr (isWritten<Format>) {
            return withinMemory([&] {
                const auto text =
                    form == FileForm::faithful ? faithfulText(dist, FileFacts(facts, count)) : savedText(dist);
                if (text) writeText(text->bytes(), out);
                return !!text;
            });
        } else {
            return reportOnlyRead<Format>();
        }
    }

private:
    using Record = typename Format::Record;

    static FileFacts factsOf(const Record& record) {
        FileFacts facts;
        if constexpr (isDescribed<Format>) Format::describe(record, facts);
        facts.addEncoding();
        return facts;
    }

    // The text of a file; null after messages.

    static RnRef<Ov::RnMemoryBuffer> savedText(Ov::RnIntensityDist& dist) {
        Record record;
        if (!Format::fromDistribution(dist, record)) return {};
        return textOfRecord<Format>(record, FileForm::asSaved);
    }

    static RnRef<Ov::RnMemoryBuffer> faithfulText(Ov::RnIntensityDist& dist, const FileFacts& facts) {
        Record record;
        if (!Format::fromDistributionFaithfully(dist, record)) return {};
        const auto web = webOf(dist);
        Format::carry(facts, web ? web->getName() : L"", record);
        auto text = textOfRecord<Format>(record, FileForm::faithful);
        if (text && !isOwn(*text)) {
            setTextsOff(record, facts);
            text = textOfRecord<Format>(record, FileForm::faithful);
        }
        return text && isReadBack(*text) ? text : RnRef<Ov::RnMemoryBuffer>();
    }

    /// Whether an importer takes the text for a file of this format.
    static bool isOwn(Ov::RnBufferedIO& text) { return recognisedClass(text) == Format::info.classId; }

    /// Puts a blank in front of those texts that let importers take the file for one of another format, and tells.
    static void setTextsOff(Record& record, const FileFacts& facts) {
        if constexpr (requires { Format::texts(record); }) {
            const auto isWell = [&] {
                const auto text = textOfRecord<Format>(record, FileForm::faithful);
                return text && isOwn(*text);
            };
            std::vector<std::pair<std::wstring*, std::wstring>> changed;  // with what else stands there
            for (std::wstring& label : Format::texts(record)) {
                if (isWell()) break;
                changed.emplace_back(&label, facts.label(L" " + textOfLabel(label), Format::textLimit));
                std::swap(label, changed.back().second);
            }
            for (auto& [label, other] : changed) {
                std::swap(*label, other);
                if (isWell()) continue;  // it was not this one
                reportMessage(messages::textSetOff, textOfLabel(*label).c_str());
                std::swap(*label, other);
            }
        }
    }

    static bool isReadBack(Ov::RnMemoryBuffer& text) { return isOwn(text) && webOfText<Format>(text); }
};

}  // namespace OvPhotometrics
