#include "tools/ovphoto/conversion.h"

#include <algorithm>
#include <cmath>
#include <iostream>

#include "components/support/path.h"
#include "tools/numbers/numbers.h"
#include "tools/ovphoto/fileAngles.h"
#include "tools/ovphoto/luminaireFile.h"
#include "tools/ovphoto/outputFile.h"
#include "tools/ovphoto/terminal.h"
#include "tools/ovphoto/webTexts.h"
#include "tools/ovphoto/webWarnings.h"

namespace OvTool {

using namespace Ov;

namespace {

/// What a file was read from: itself, and its tilt file.
InputFiles inputsOf(const ReadResult& source) {
    InputFiles inputs(source.web ? filesOf(*source.web) : std::vector<std::string>());
    inputs.add(source.file);
    return inputs;
}

/// Writes what was read as another file in memory.
std::optional<LuminaireFile> writeAnew(const Conversion& conversion, const HostSession& session,
                                       const ReadResult& source, const std::vector<Fact>& facts,
                                       const WebLight& light, std::vector<std::string>& messages) {
    if (!conversion.asSaved)
        return makeFile(session, conversion.out, *conversion.target, *light, FileForm::faithful, facts, messages);
    const auto asRead = session.distribute(*source.web, source.web->getLumens());
    return makeFile(session, conversion.out, *conversion.target, *asRead, FileForm::asSaved, {}, messages);
}

void append(std::vector<std::string>& all, std::vector<std::string> texts) {
    all.insert(all.end(), std::move_iterator(texts.begin()), std::move_iterator(texts.end()));
}

void reportLoss(ConversionReport& report, const Conversion& conversion, RnWebIntensityDist& light,
                const LuminaireFile& made) {
    const ConversionLoss loss = measureLoss(light, *made.light);
    report.loss = {static_cast<float>(loss.candela), static_cast<float>(loss.candelaPercent),
                   static_cast<float>(loss.fluxPercent)};
    append(report.warnings, lossWarnings(loss, *conversion.target, light, made));
}

/// What the output does not hold of the source, the flux of its lamps included.
std::vector<ConversionReport::Dropped> droppedOf(const ReadResult& source, const Format& target,
                                                 const LuminaireFile& made) {
    std::vector<ConversionReport::Dropped> dropped;
    for (const Fact& fact : droppedFacts(source.facts, made.facts))
        dropped.push_back({toUtf8(fact.key), toUtf8(fact.text)});
    const float lamps = fileInfoOf(*source.web).lampLumens;
    if (lamps > 0 && !target.traits.holdsLampLumens && made.lampLumens != lamps)
        dropped.push_back({"lampLumens", exactNumber(lamps)});
    return dropped;
}

ConversionReport convert(const Conversion& conversion, const HostSession& session, const ReadResult& source) {
    ConversionReport report = unconverted(conversion, conversion.brief ? source.told() : source.reasons());
    report.format = source.format;
    if (!source.web) return report;

    const std::vector<Fact>& facts = source.facts;
    const WebLight light = session.lightOf(*source.web);
    if (const auto warning = negativeFlux(*source.web)) report.warnings.push_back(*warning);
    std::vector<std::string> messages;
    const auto made = writeAnew(conversion, session, source, facts, light, messages);
    if (made && made->light) {
        report.dropped = droppedOf(source, *conversion.target, *made);
        if (const auto warning = lostTypeB(source, made->facts)) report.warnings.push_back(*warning);
        reportLoss(report, conversion, *light, *made);
    } else if (made) {
        // A save is what it is, readable or not.
        (conversion.asSaved ? report.warnings : report.messages).push_back(made->refusal);
    }
    if (made && (made->light || conversion.asSaved)) {
        std::string error = inputsOf(source).refusal(conversion.out);
        if (error.empty()) error = writeFile(conversion.out, made->bytes);
        if (!error.empty()) messages.push_back(conversion.out + ": " + error);
        report.ok = error.empty();
    }
    append(report.messages, std::move(messages));
    return report;
}

/// The keys, each once.
std::string keysOf(const std::vector<ConversionReport::Dropped>& facts) {
    std::vector<std::string> keys;
    for (const auto& [key, value] : facts)
        if (std::find(keys.begin(), keys.end(), key) == keys.end()) keys.push_back(key);
    std::string text;
    for (const std::string& key : keys) text += (text.empty() ? "" : ", ") + key;
    return text;
}

std::string percentText(double percent) { return shortNumber(std::round(percent * 1000) / 1000 + 0.0) + " %"; }

std::string lossText(const ConversionReport& report) {
    if (!report.loss) return "cannot be read back";
    std::string text = "largest difference " + shortNumber(report.loss->candela) + " cd (" +
                       percentText(report.loss->candelaPercent) + "), flux " +
                       percentText(report.loss->fluxPercent);
    if (!report.dropped.empty()) text += "; dropped " + keysOf(report.dropped);
    return text;
}

std::vector<std::string> textsOf(const Json& array) { return array.get<std::vector<std::string>>(); }

}  // namespace

ConversionReport convertFile(const Conversion& conversion, const HostSession& session) {
    try {
        return convert(conversion, session, session.read(conversion.in, conversion.as));
    } catch (...) {
        return unconverted(conversion, {"cannot be converted: " + currentExceptionText()});
    }
}

ConversionReport unconverted(const Conversion& conversion, std::vector<std::string> reasons) {
    ConversionReport report;
    report.file = conversion.in;
    report.out = conversion.out;
    report.target = conversion.target->name;
    report.messages = std::move(reasons);
    return report;
}

Json toJson(const ConversionReport& report) {
    const auto lost = [&](float ConversionReport::Loss::*what) {
        return report.loss ? Json(*report.loss.*what) : Json();
    };
    Json dropped = Json::array();
    for (const auto& [key, value] : report.dropped) dropped.push_back({{"key", key}, {"value", value}});
    return {{"file", report.file},
            {"out", report.out},
            {"format", report.format.empty() ? Json() : Json(report.format)},
            {"target", report.target},
            {"maxCandelaDifference", lost(&ConversionReport::Loss::candela)},
            {"maxCandelaDifferencePercent", lost(&ConversionReport::Loss::candelaPercent)},
            {"fluxDifferencePercent", lost(&ConversionReport::Loss::fluxPercent)},
            {"dropped", dropped},
            {"warnings", report.warnings},
            {"ok", report.ok},
            {"messages", report.messages}};
}

std::optional<ConversionReport> reportOf(const Json& json) {
    if (!json.is_object()) return {};
    ConversionReport report;
    report.file = json["file"];
    report.out = json["out"];
    if (!json["format"].is_null()) report.format = json["format"];
    report.target = json["target"];
    if (!json["maxCandelaDifference"].is_null())
        report.loss = {json["maxCandelaDifference"], json["maxCandelaDifferencePercent"],
                       json["fluxDifferencePercent"]};
    for (const Json& fact : json["dropped"]) report.dropped.push_back({fact["key"], fact["value"]});
    report.warnings = textsOf(json["warnings"]);
    report.ok = json["ok"];
    report.messages = textsOf(json["messages"]);
    return report;
}

void printReport(const ConversionReport& report, bool json) {
    if (json) {
        printLine(toJson(report));
        std::cout.flush();  // what is done is told even if a later file ends the process
    } else if (report.ok) {
        sayOf(report.out, report.file + " -> " + report.out + ": " + report.format + " to " + report.target +
                              ", " + lossText(report));
    }
    for (const std::string& message : report.messages) complain(report.file + ": " + message);
    for (const std::string& warning : report.warnings) complain(report.file + ": warning: " + warning);
}

}  // namespace OvTool
