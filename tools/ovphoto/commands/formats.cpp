#include <CLI/CLI.hpp>
#include <cstdio>
#include <memory>

#include "components/support/path.h"
#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/table.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

using namespace Ov;

namespace {

struct FormatsOptions {
    std::string detect;
    bool json = false;
};

std::string uidText(const RnUid& id) {
    char text[40];
    std::snprintf(text, sizeof text, "%08x %08x %08x %08x", id.w0, id.w1, id.w2, id.w3);
    return text;
}

int listBuilders(const FormatsOptions& options, const HostSession& session) {
    Table table;
    table.add({"name", "category", "class id", "extension", "creatable", "description"});
    for (const auto& builder : session.manager().builders()) {
        const std::string name = toUtf8(builder->getName());
        const std::string category = toUtf8(builder->getCategory());
        const std::string description = toUtf8(builder->getDescription());
        const std::string id = uidText(builder->getClassId());
        const Format* const format = session.formats().ofClass(builder->getClassId());
        const std::string extension = format ? format->extension : "";
        if (options.json) {
            printLine(Json{{"name", name},
                           {"category", category},
                           {"description", description},
                           {"classId", id},
                           {"extension", extension.empty() ? Json() : Json(extension)},
                           {"creatable", builder->isCreatable()}});
        } else {
            table.add({name, category, id, extension.empty() ? "-" : extension,
                       builder->isCreatable() ? "yes" : "no", description});
        }
    }
    if (!options.json) table.print();
    return exitWell;
}

void printDetection(const std::string& file, const std::string& taken, const Json& canImport) {
    say(file + ": " + (taken.empty() ? unknownFormat : taken));
    Table table;
    for (const auto& [format, accepts] : canImport.items()) {
        table.add({format, accepts.get<bool>() ? "accepts it" : "does not accept it"});
    }
    table.print(2);
}

int detect(const FormatsOptions& options, const HostSession& session) {
    ReadResult result;
    result.file = options.detect;
    const RnRef<RnBufferedIO> io = openFile(options.detect, result.error);
    if (!io) {
        showReasons(result);
        if (options.json) printRefusal(result);
        return exitFailed;
    }
    Json canImport = Json::object();
    for (const Format& format : session.formats()) canImport[format.name] = format.builder->canImport(io.get());
    const Format* const format = session.formats().recognise(*io);
    const std::string taken = format ? format->name : "";
    if (options.json) {
        printLine(Json{
            {"file", options.detect}, {"format", taken.empty() ? Json() : Json(taken)}, {"canImport", canImport}});
    } else {
        printDetection(options.detect, taken, canImport);
    }
    return exitWell;
}

}  // namespace

Action declareFormats(CLI::App& app) {
    auto options = std::make_shared<FormatsOptions>();
    app.add_option("--detect", options->detect, "Tell which readers accept this file, and which one is taken")
        ->type_name("FILE");
    addJsonFlag(app, options->json);
    return [options](const HostSession& session) {
        return options->detect.empty() ? listBuilders(*options, session) : detect(*options, session);
    };
}

}  // namespace OvTool
