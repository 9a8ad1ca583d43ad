#include "tools/ovphoto/pictures/drawnFile.h"

#include "components/support/path.h"
#include "tools/numbers/numbers.h"
#include "tools/ovphoto/fileAngles.h"

namespace OvTool {

namespace {

std::string angleText(const std::optional<OvPlot::AngleSpan>& angle) {
    return angle ? fixedNumber(angle->width(), 1) + "\u00b0" : "\u2013";
}

std::string anglesNote(const char* what, const std::optional<OvPlot::AngleSpan>& first,
                       const std::optional<OvPlot::AngleSpan>& second) {
    const std::string one = angleText(first);
    const std::string other = angleText(second);
    return what + (" " + one) + (one == other ? "" : " / " + other);
}

OvPlot::Subject subjectOf(const DrawnFile& file) {
    Ov::RnPhotoWebData& web = *file.source.web;
    const auto& [first, second] = std::pair(file.angles.at(0), file.angles.at(1));
    OvPlot::Subject subject{file.light.get(), mainFrame(web), titleOf(file), {}, {first.beam, second.beam}};
    subject.notes = {"Peak " + shortNumber(file.light->getPeakIntensity()) + " cd",
                     "Flux " + shortNumber(luminaireLumensOf(web)) + " lm"};
    if (const float lamps = fileInfoOf(web).lampLumens; lamps > 0)
        subject.notes.push_back("Lamps " + shortNumber(lamps) + " lm");
    subject.notes.push_back(anglesNote("Beam", first.beam, second.beam));
    subject.notes.push_back(anglesNote("Field", first.field, second.field));
    return subject;
}

}  // namespace

std::optional<DrawnFile> drawnFile(const HostSession& session, ReadResult& result) {
    if (!result.web) return {};
    DrawnFile file{std::move(result), {}, {}};
    file.light = session.lightOf(*file.source.web);
    file.angles = beamAngles(*file.light);
    return file;
}

std::string titleOf(const DrawnFile& file) {
    for (const wchar_t* key : {L"LUMINAIRE", L"title", L"label 1", L"line 1", L"LUMCAT", L"line"}) {
        const std::wstring* text = findFact(file.source.facts, key);
        if (text && text->find_first_not_of(L' ') != std::wstring::npos) return Ov::toUtf8(*text);
    }
    return Ov::toUtf8(file.source.web->getName());
}

OvPlot::Diagram diagramOf(std::span<const DrawnFile> files) {
    OvPlot::Diagram diagram;
    for (const DrawnFile& file : files) diagram.subjects.push_back(subjectOf(file));
    diagram.title =
        files.size() > 1 ? std::to_string(files.size()) + " luminaires" : diagram.subjects.front().name;
    return diagram;
}

}  // namespace OvTool
