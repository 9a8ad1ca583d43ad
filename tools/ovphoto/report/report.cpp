#include <CLI/CLI.hpp>
#include <algorithm>
#include <deque>
#include <filesystem>
#include <future>
#include <thread>

#include "components/support/path.h"
#include "tools/numbers/numbers.h"
#include "tools/ovphoto/commands/pictureOptions.h"
#include "tools/ovphoto/expandPaths.h"
#include "tools/ovphoto/fileAngles.h"
#include "tools/ovphoto/outputFile.h"
#include "tools/ovphoto/progress.h"
#include "tools/ovphoto/report/html.h"
#include "tools/ovphoto/report/page.h"
#include "tools/ovphoto/standardStreams.h"
#include "tools/ovphoto/terminal.h"
#include "tools/ovphoto/webTexts.h"

namespace OvTool {

namespace fs = std::filesystem;

namespace {

fs::path nativeOf(const std::string& path) { return Ov::nativePath(Ov::fromUtf8(path)); }

int fail(const std::string& file, const std::string& error) {
    complain(file + ": " + error);
    return exitFailed;
}

int reportOne(const ReportOptions& options, const HostSession& session) {
    ReadResult result = session.read(options.paths.front(), options.as);
    showReasons(result);
    auto file = drawnFile(session, result);
    if (!file) return exitFailed;
    const std::string page = datasheetPage(datasheetOf(std::move(*file)), "");
    const std::string error = writeFile(options.out, page);
    return error.empty() ? exitWell : fail(options.out, error);
}

/// An index and its pages, which lie in a folder beside it named for it. Nothing is in its place before all of it is
/// complete.
class IndexFiles {
public:
    explicit IndexFiles(const std::string& index)
        : _index(index),
          _name(pathText(nativeOf(index).stem()) + "-pages"),
          _path(nativeOf(index).parent_path() / nativeOf(_name)) {}
    IndexFiles(const IndexFiles&) = delete;
    IndexFiles& operator=(const IndexFiles&) = delete;
    ~IndexFiles() {
        std::error_code ignored;
        _files.reset();
        if (_made) fs::remove(_path, ignored);  // when it is empty
    }

    /// Empty, or why there is no folder.
    std::string makeFolder() {
        std::error_code error;
        _made = fs::create_directory(_path, error);
        if (!error && fs::is_directory(_path)) return {};
        return "the folder " + pathText(_path) +
               " cannot be made: " + (error ? error.message() : "a file has its name");
    }
    /// A file that is shown, and so is not written.
    void addInput(const std::string& file) { _inputs.add(file); }
    /// @{
    /// Empty, or why it cannot be written.
    std::string addPage(const std::string& page, const std::string& html) {
        return add(pathText(_path / nativeOf(page)), html);
    }
    std::string finish(const std::string& html) {
        const std::string error = add(_index, html);
        return error.empty() ? _files->putInPlace() : error;
    }
    /// @}
    std::string urlOf(const std::string& page) const { return urlPart(_name) + "/" + urlPart(page); }
    /// A file's path as it leads there from the index.
    std::string pathTo(const std::string& file) const {
        const auto place = [](const fs::path& path) { return fs::absolute(path).lexically_normal(); };
        const fs::path path = place(nativeOf(file)).lexically_relative(place(nativeOf(_index)).parent_path());
        return path.empty() ? file : pathText(path);
    }

private:
    std::string add(const std::string& file, const std::string& html) {
        const std::string refusal = _inputs.refusal(file);
        return refusal.empty() ? _files->add(file, html) : refusal;
    }

    std::string _index;
    std::string _name;
    fs::path _path;
    InputFiles _inputs;
    std::optional<OutputFiles> _files{std::in_place};
    bool _made = false;
};

struct Entry {
    std::string row;
    std::string pageName;
    std::string page;  // empty for a file that was refused
};

std::string cell(const std::string& text) { return "<td>" + escaped(text) + "</td>"; }

std::string numberCell(const std::optional<double>& value, const std::string& text) {
    return "<td class=\"number\" data-value=\"" + (value ? shortNumber(*value) : "-1") + "\">" + escaped(text) +
           "</td>";
}

std::string angleCell(const std::optional<OvPlot::AngleSpan>& angle) {
    const auto width = angle ? std::optional(angle->width()) : std::nullopt;
    return numberCell(width, width ? fixedNumber(*width, 1) : "\u2013");
}

std::string remarksCell(const std::vector<std::string>& remarks) {
    std::string text;
    for (const std::string& remark : remarks) text += (text.empty() ? "" : "; ") + remark;
    return cell(text);
}

/// A name for a page that any file system and link takes.
std::string pageNameOf(const std::string& file, std::size_t number) {
    std::string name = std::to_string(number);
    name.insert(0, 4 - std::min<std::size_t>(name.size(), 4), '0');
    name += '-';
    for (const char c : Ov::toUtf8(Ov::pathStem(Ov::fromUtf8(file)))) {
        const bool plain = (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9');
        if (plain || name.back() != '-') name += plain ? c : '-';
        if (name.size() > 48) break;
    }
    return name + ".html";
}

Entry refusedEntry(const ReadResult& result, const IndexFiles& files) {
    return {"<tr class=\"refused\"><td></td><th scope=\"row\">" + escaped(files.pathTo(result.file)) +
                "</th><td></td>" + cell(result.format) + numberCell({}, "") + numberCell({}, "") +
                numberCell({}, "") + numberCell({}, "") + "<td>refused</td>" + remarksCell(result.told()) +
                "</tr>\n",
            "", ""};
}

Entry entryOf(const Datasheet& sheet, std::size_t number, const IndexFiles& files, const std::string& indexUrl) {
    const DrawnFile& file = sheet.file;
    Ov::RnPhotoWebData& web = *file.source.web;
    const float lumens = luminaireLumensOf(web);
    const float peak = file.light->getPeakIntensity();
    const std::string page = pageNameOf(file.source.file, number);
    std::string row =
        "<tr><td>" + thumbnail(sheet, "t" + std::to_string(number) + "-") + "</td><th scope=\"row\"><a href=\"" +
        files.urlOf(page) + "\">" + escaped(files.pathTo(file.source.file)) + "</a></th>" + cell(titleOf(file)) +
        cell(file.source.format) + numberCell(lumens, shortNumber(lumens)) + numberCell(peak, shortNumber(peak)) +
        angleCell(file.angles[0].beam) + angleCell(file.angles[1].beam) + cell(symmetryName(web.getSymmetry())) +
        remarksCell(sheet.remarks) + "</tr>\n";
    return {std::move(row), page, datasheetPage(sheet, indexUrl)};
}

std::string indexPage(const std::string& rows, std::size_t files, std::size_t refused) {
    static constexpr const char* headings[] = {"File",     "Luminaire",       "Format",           "Flux, lm",
                                               "Peak, cd", "Beam C0, \u00b0", "Beam C90, \u00b0", "Symmetry",
                                               "Remarks"};
    std::string body = "<header><h1>Photometric files</h1>\n<p class=\"muted\">" + std::to_string(files) +
                       (files == 1 ? " file, " : " files, ") + std::to_string(refused) +
                       " refused</p></header>\n<main>\n<div class=\"tools\" id=\"tools\" hidden>"
                       "<label for=\"filter\">Filter</label> <input type=\"search\" id=\"filter\">"
                       "<output id=\"shown\" for=\"filter\" aria-live=\"polite\"></output></div>\n"
                       "<table class=\"index\" id=\"files\"><caption>Files, by name until a heading sorts them"
                       "</caption><thead><tr><th scope=\"col\">Diagram</th>";
    for (const char* heading : headings)
        body += std::string("<th scope=\"col\"><button type=\"button\">") + heading + "</button></th>";
    return htmlPage("Photometric files", body + "</tr></thead><tbody>\n" + rows + "</tbody></table>\n</main>\n",
                    indexScript);
}

/// Makes pages at the side while the next files are read, and takes them in order.
class Maker {
public:
    Maker(IndexFiles& files, std::string indexUrl) : _index(files), _indexUrl(std::move(indexUrl)) {}

    void add(ReadResult result, const HostSession& session) {
        const std::size_t number = ++_files;
        _index.addInput(result.file);
        const SignalsHeld held;  // they come to this thread alone
        if (auto file = drawnFile(session, result)) {
            auto sheet = std::make_shared<Datasheet>(datasheetOf(std::move(*file)));
            _underWay.push_back(std::async(
                std::launch::async, [this, sheet, number] { return entryOf(*sheet, number, _index, _indexUrl); }));
        } else {
            ++_refused;
            std::promise<Entry> entry;
            entry.set_value(refusedEntry(result, _index));
            _underWay.push_back(entry.get_future());
        }
        if (_underWay.size() > std::clamp(std::thread::hardware_concurrency(), 1U, 16U)) takeOne();
    }
    void finish() {
        while (!_underWay.empty()) takeOne();
    }

    std::size_t files() const { return _files; }
    std::size_t refused() const { return _refused; }
    const std::string& rows() const { return _rows; }
    /// Why a page could not be written; empty when all were.
    const std::string& error() const { return _error; }

private:
    void takeOne() {
        const Entry entry = _underWay.front().get();
        _underWay.pop_front();
        _rows += entry.row;
        if (_error.empty() && !entry.page.empty()) _error = _index.addPage(entry.pageName, entry.page);
    }

    IndexFiles& _index;
    std::string _indexUrl;
    std::size_t _files = 0;
    std::size_t _refused = 0;
    std::string _rows;
    std::string _error;
    std::deque<std::future<Entry>> _underWay;
};

/// Whether a file that was found in a folder is none of ours.
bool isForeign(const FoundFile& file, const ReadResult& result, const HostSession& session) {
    return file.fromFolder && result.format.empty() && !session.formats().ofExtension(file.path);
}

int reportMany(const ReportOptions& options, const HostSession& session) {
    const std::vector<FoundFile> files = expandPaths(options.paths);
    IndexFiles index(options.out);
    const std::string refusal = index.makeFolder();
    if (!refusal.empty()) return fail(options.out, refusal);
    Maker maker(index, "../" + urlPart(pathText(nativeOf(options.out).filename())));
    {
        Progress progress(files.size());
        for (const FoundFile& file : files) {
            progress.next();
            ReadResult result;
            result.file = file.path;
            result.error = file.error;
            if (file.error.empty()) result = session.read(file.path, options.as);
            if (!isForeign(file, result, session)) maker.add(std::move(result), session);
            if (!maker.error().empty()) break;
        }
        maker.finish();
    }
    if (maker.files() == 0) return fail(options.paths.front(), "no photometric file is in there");
    if (!maker.error().empty()) return fail(options.out, "a page of it " + maker.error());
    const std::string error = index.finish(indexPage(maker.rows(), maker.files(), maker.refused()));
    if (!error.empty()) return fail(options.out, error);
    say(options.out + ": " + std::to_string(maker.files()) + (maker.files() == 1 ? " file, " : " files, ") +
        std::to_string(maker.refused()) + " refused");
    return maker.refused() == 0 ? exitWell : exitFailed;
}

}  // namespace

int runReport(const ReportOptions& options, const HostSession& session) {
    const bool toStream = isStandardStream(options.out);
    if (!toStream && CLI::detail::to_lower(nativeOf(options.out).extension().string()) != ".html") {
        complain(options.out + ": does not end in .html");
        return exitUsage;
    }
    const std::string refusal = InputFiles(options.paths).refusal(options.out);
    if (!refusal.empty()) return fail(options.out, refusal);
    std::error_code error;
    const bool one = options.paths.size() == 1 && (isStandardStream(options.paths.front()) ||
                                                   !fs::is_directory(nativeOf(options.paths.front()), error));
    if (toStream && !one) {
        complain("standard output takes the page of one file, not an index and its pages");
        return exitUsage;
    }
    return (one ? reportOne : reportMany)(options, session);
}

}  // namespace OvTool
