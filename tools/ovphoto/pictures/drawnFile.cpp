#include "tools/ovphoto/pictures/drawnFile.h"

#include <algorithm>
#include <cmath>

#include "host/platform/path.h"
#include "tools/ovphoto/numbers.h"
#include "tools/ovphoto/webTexts.h"

namespace OvTool {

namespace {

constexpr const char* candela = "cd";
constexpr const char* perKilolumen = "cd/klm";

std::string angleText(const std::optional<OvPlot::AngleSpan>& angle) {
    return angle ? fixedNumber(angle->width(), 1) + "\u00b0" : "\u2013";
}

std::string anglesNote(const char* what, const std::optional<OvPlot::AngleSpan>& first,
                       const std::optional<OvPlot::AngleSpan>& second) {
    const std::string one = angleText(first);
    const std::string other = angleText(second);
    return what + (" " + one) + (one == other ? "" : " / " + other);
}

OvPlot::Subject subjectOf(const DrawnFile& file, const WebLight& light, const std::string& unit) {
    const auto& [first, second] = std::pair(file.angles.at(0), file.angles.at(1));
    OvPlot::Subject subject{
        light.get(), mainFrame(*file.source.web), titleOf(file), {}, {first.beam, second.beam}};
    subject.notes = {"Peak " + shortNumber(light->getPeakIntensity()) + " " + unit};
    if (file.source.format != "NIMB")  // holds no flux
        subject.notes.push_back("Flux " + shortNumber(file.source.web->getLumens()) + " lm");
    subject.notes.push_back(anglesNote("Beam", first.beam, second.beam));
    subject.notes.push_back(anglesNote("Field", first.field, second.field));
    return subject;
}

bool holdsPerKilolumen(const DrawnFile& file) { return unitOf(file.source) == std::string_view(perKilolumen); }

/// Adds a file's light in the unit of the diagram.
void addSubject(OvPlot::Diagram& diagram, const HostSession& session, const DrawnFile& file,
                std::vector<WebLight>& lights) {
    const bool converted = diagram.unit == perKilolumen && !holdsPerKilolumen(file);
    lights.push_back(converted ? session.distribute(*file.source.web, 1000) : file.light);
    diagram.subjects.push_back(subjectOf(file, lights.back(), diagram.unit));
    diagram.title = diagram.subjects.front().name;
}

}  // namespace

std::optional<DrawnFile> drawnFile(const HostSession& session, ReadResult& result) {
    if (!result.web) return {};
    DrawnFile file{std::move(result), {}, {}};
    file.light = session.distribute(*file.source.web, file.source.web->getLumens());
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

OvPlot::Diagram diagramOf(const HostSession& session, const DrawnFile& file, std::vector<WebLight>& lights) {
    OvPlot::Diagram diagram;
    diagram.unit = unitOf(file.source);
    addSubject(diagram, session, file, lights);
    return diagram;
}

OvPlot::Diagram diagramOf(const HostSession& session, const std::vector<DrawnFile>& files,
                          std::vector<WebLight>& lights) {
    OvPlot::Diagram diagram;
    diagram.unit = std::any_of(files.begin(), files.end(), holdsPerKilolumen) ? perKilolumen : candela;
    for (const DrawnFile& file : files) addSubject(diagram, session, file, lights);
    if (files.size() > 1) diagram.title = std::to_string(files.size()) + " luminaires";
    return diagram;
}

OvPlot::Diagram trueDiagramOf(const HostSession& session, const DrawnFile& file, std::vector<WebLight>& lights) {
    OvPlot::Diagram diagram;
    diagram.unit = file.source.format == "NIMB" ? perKilolumen : candela;
    lights.push_back(lightOf(session, file.source));
    diagram.subjects.push_back(subjectOf(file, lights.back(), diagram.unit));
    diagram.title = diagram.subjects.front().name;
    return diagram;
}

}  // namespace OvTool
