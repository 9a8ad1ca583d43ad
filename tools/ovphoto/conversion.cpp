#include "tools/ovphoto/conversion.h"

#include <algorithm>
#include <cmath>
#include <iostream>

#include "tools/numbers/numbers.h"
#include "tools/ovphoto/fileAngles.h"
#include "tools/ovphoto/lightFile.h"
#include "tools/ovphoto/outputFile.h"
#include "tools/ovphoto/terminal.h"
#include "tools/ovphoto/webTexts.h"
#include "tools/ovphoto/webWarnings.h"

namespace OvTool {

using namespace Ov;

namespace {

void append(Json& array, const std::vector<std::string>& texts) {
    for (const std::string& text : texts) array.push_back(text);
}

/// What a file was read from: itself, and its tilt file.
InputFiles inputsOf(const ReadResult& source) {
    InputFiles inputs(source.web ? filesOf(*source.web) : std::vector<std::string>());
    inputs.add(source.file);
    return inputs;
}

/// Writes what was read as another file in memory.
std::optional<LightFile> writeAnew(const Conversion& conversion, const HostSession& session,
                                   const ReadResult& source, const std::vector<Fact>& facts, const WebLight& light,
                                   std::vector<std::string>& messages) {
    if (!conversion.asSaved)
        return makeFile(session, conversion.out, *conversion.target, *light, FileForm::faithful, facts, messages);
    const auto asRead = session.distribute(*source.web, source.web->getLumens());
    return makeFile(session, conversion.out, *conversion.target, *asRead, FileForm::asSaved, {}, messages);
}

void reportLoss(Json& report, const Conversion& conversion, RnWebIntensityDist& light, const LightFile& made) {
    const ConversionLoss loss = measureLoss(light, *made.light);
    report["maxCandelaDifference"] = static_cast<float>(loss.candela);
    report["maxCandelaDifferencePercent"] = static_cast<float>(loss.candelaPercent);
    report["fluxDifferencePercent"] = static_cast<float>(loss.fluxPercent);
    append(report["warnings"], lossWarnings(loss, *conversion.target, light, made));
}

/// What the output does not hold of the source, the flux of its lamps included.
Json droppedOf(const ReadResult& source, const Format& target, const LightFile& made) {
    Json dropped = factsToJson(droppedFacts(source.facts, made.facts));
    const float lamps = fileInfoOf(*source.web).lampLumens;
    if (lamps > 0 && !target.traits.holdsLampLumens && made.lampLumens != lamps)
        dropped.push_back({{"key", "lampLumens"}, {"value", exactNumber(lamps)}});
    return dropped;
}

Json convert(const Conversion& conversion, const HostSession& session, const ReadResult& source) {
    Json report = unconverted(conversion, conversion.brief ? source.told() : source.reasons());
    if (!source.format.empty()) report["format"] = source.format;
    if (!source.web) return report;

    const std::vector<Fact>& facts = source.facts;
    const WebLight light = session.lightOf(*source.web);
    if (const auto warning = negativeFlux(*source.web)) append(report["warnings"], {*warning});
    std::vector<std::string> messages;
    const auto made = writeAnew(conversion, session, source, facts, light, messages);
    if (made && made->light) {
        report["dropped"] = droppedOf(source, *conversion.target, *made);
        if (const auto warning = lostTypeB(source, made->facts)) append(report["warnings"], {*warning});
        reportLoss(report, conversion, *light, *made);
    } else if (made) {
        // A save is what it is, readable or not.
        append(report[conversion.asSaved ? "warnings" : "messages"], {made->refusal});
    }
    if (made && (made->light || conversion.asSaved)) {
        std::string error = inputsOf(source).refusal(conversion.out);
        if (error.empty()) error = writeFile(conversion.out, made->bytes);
        if (!error.empty()) messages.push_back(conversion.out + ": " + error);
        report["ok"] = error.empty();
    }
    append(report["messages"], messages);
    return report;
}

/// The keys, each once.
std::string keysOf(const Json& facts) {
    std::vector<std::string> keys;
    for (const Json& fact : facts) {
        const auto key = fact["key"].get<std::string>();
        if (std::find(keys.begin(), keys.end(), key) == keys.end()) keys.push_back(key);
    }
    std::string text;
    for (const std::string& key : keys) text += (text.empty() ? "" : ", ") + key;
    return text;
}

std::string percentText(const Json& percent) {
    return shortNumber(std::round(percent.get<double>() * 1000) / 1000 + 0.0) + " %";
}

std::string lossText(const Json& report) {
    if (report["maxCandelaDifference"].is_null()) return "cannot be read back";
    std::string text = "largest difference " + shortNumber(report["maxCandelaDifference"].get<double>()) +
                       " cd (" + percentText(report["maxCandelaDifferencePercent"]) + "), flux " +
                       percentText(report["fluxDifferencePercent"]);
    if (!report["dropped"].empty()) text += "; dropped " + keysOf(report["dropped"]);
    return text;
}

}  // namespace

Json convertFile(const Conversion& conversion, const HostSession& session) {
    try {
        return convert(conversion, session, session.read(conversion.in, conversion.as));
    } catch (...) {
        return unconverted(conversion, {"cannot be converted: " + currentExceptionText()});
    }
}

Json unconverted(const Conversion& conversion, const std::vector<std::string>& reasons) {
    return {{"file", conversion.in},
            {"out", conversion.out},
            {"format", Json()},
            {"target", conversion.target->name},
            {"maxCandelaDifference", Json()},
            {"maxCandelaDifferencePercent", Json()},
            {"fluxDifferencePercent", Json()},
            {"dropped", Json::array()},
            {"warnings", Json::array()},
            {"ok", false},
            {"messages", reasons}};
}

void printReport(const Json& report, const Conversion& conversion, bool json) {
    if (json) {
        printLine(report);
        std::cout.flush();  // what is done is told even if a later file ends the process
    } else if (report["ok"].get<bool>()) {
        sayOf(conversion.out, conversion.in + " -> " + conversion.out + ": " +
                                  report["format"].get<std::string>() + " to " + conversion.target->name + ", " +
                                  lossText(report));
    }
    for (const Json& message : report["messages"]) complain(conversion.in + ": " + message.get<std::string>());
    for (const Json& warning : report["warnings"])
        complain(conversion.in + ": warning: " + warning.get<std::string>());
}

}  // namespace OvTool
