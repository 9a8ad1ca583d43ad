#include <CLI/CLI.hpp>
#include <algorithm>
#include <charconv>
#include <memory>

#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/commands/convertFolder.h"
#include "tools/ovphoto/commands/parsedOption.h"
#include "tools/ovphoto/conversion.h"
#include "tools/ovphoto/standardStreams.h"

namespace OvTool {

namespace {

constexpr std::size_t mostJobs = 64;

std::optional<std::size_t> parseJobs(const std::string& text) {
    std::size_t jobs = 0;
    const char* const end = text.data() + text.size();
    const bool whole = std::from_chars(text.data(), end, jobs).ptr == end;
    return whole && jobs >= 1 && jobs <= mostJobs ? std::optional(jobs) : std::nullopt;
}

int convertOne(const ConvertOptions& options, const HostSession& session) {
    const Conversion conversion{options.paths[0], options.paths[1], options.as,
                                options.target,   options.asSaved,  options.brief};
    const ConversionReport report = convertFile(conversion, session);
    printReport(report, options.json);
    return report.ok ? exitWell : exitFailed;
}

/// What depends on more than one argument.
void checkArguments(ConvertOptions& options) {
    if (!options.json) options.brief = true;
    if (!options.folder.empty()) {
        if (std::any_of(options.paths.begin(), options.paths.end(), isStandardStream))
            throw CLI::ValidationError("--into", "what comes from standard input has no name there");
        return;
    }
    if (options.paths.size() != 2) throw CLI::ValidationError("IN OUT", "two files are wanted, or --into FOLDER");
    if (options.json && isStandardStream(options.paths[1]))
        throw CLI::ValidationError("--json", "standard output takes the file");
}

}  // namespace

Action declareConvert(CLI::App& app) {
    auto options = std::make_shared<ConvertOptions>();
    app.add_option("PATH", options->paths,
                   "IN and OUT, the file to read and the file to write, - for standard input and output; with "
                   "--into, any number of files, or folders "
                   "to search for them")
        ->required();
    CLI::Option* to = addToOption(app, options->to);
    CLI::Option* into = app.add_option("--into", options->folder,
                                       "Write into this folder, under the names of the files with the format's "
                                       "extension; no file is written twice or over one that is read")
                            ->type_name("FOLDER")
                            ->needs(to);
    addParsed(app, {"--jobs", "1..64", "Convert that many files at a time, in as many processes"}, parseJobs,
              [options](std::size_t jobs) { options->jobs = jobs; })
        ->needs(into);
    app.add_flag("--as-saved", options->asSaved,
                 "Write what a web's own save writes, relative values as a rule, instead of candela for other "
                 "programs");
    app.add_flag("--brief", options->brief)
        ->group("");  // for the tool's own processes: JSON of what people are told
    addAsOption(app, options->as);
    addJsonFlag(app, options->json);
    app.callback([options] { checkArguments(*options); });
    return [options](const HostSession& session) {
        options->as = sourceFormat(session, options->as);
        options->target = &targetFormat(session, options->to, options->paths.back());
        return options->folder.empty() ? convertOne(*options, session) : convertIntoFolder(*options, session);
    };
}

}  // namespace OvTool
