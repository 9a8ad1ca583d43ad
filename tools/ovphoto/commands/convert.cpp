#include <CLI/CLI.hpp>
#include <iostream>
#include <memory>

#include "host/componentManager/devices.h"
#include "host/componentManager/persistant.h"
#include "host/componentManager/stream.h"
#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/outputFile.h"

namespace OvTool {

using namespace Ov;

namespace {

struct ConvertOptions {
    std::string in;
    std::string out;
    std::string as;
    bool asSaved = false;
};

/// What the web's own save writes into a text stream.
std::string savedBytes(RnPhotoWebData& web) {
    const auto buffer = rnCreate<RnMemoryBuffer>();
    RnStream stream(buffer.get(), RnStream::Form::text);
    rnCast<RnPersistant>(&web)->save(stream);
    return buffer->bytes();
}

/// Writes the web to the output file; empty, or why that failed.
std::string writeSaved(RnPhotoWebData& web, const std::string& out) {
    try {
        return writeFile(out, savedBytes(web));
    } catch (...) {
        return "cannot be written: " + currentExceptionText();
    }
}

int runConvert(const ConvertOptions& options, const HostSession& session) {
    const ReadResult result = session.read(options.in, options.as);
    showReasons(result);
    if (!result.web) return exitFailed;
    const std::string error = writeSaved(*result.web, options.out);
    if (error.empty()) return exitWell;
    std::cerr << options.out << ": " << error << '\n';
    return exitFailed;
}

}  // namespace

Action declareConvert(CLI::App& app) {
    auto options = std::make_shared<ConvertOptions>();
    app.add_option("IN", options->in, "Photometric file to read")->required();
    app.add_option("OUT", options->out, "File to write, in the format of the one that was read")->required();
    app.add_flag("--as-saved", options->asSaved, "Write what the web's own save writes")->required();
    addAsOption(app, options->as);
    return [options](const HostSession& session) { return runConvert(*options, session); };
}

}  // namespace OvTool
