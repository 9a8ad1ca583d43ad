#include "tools/ovphoto/report/html.h"

#include <algorithm>

#include "tools/ovphoto/report/assets.h"

namespace OvTool {

const Asset& pageScript = pageScriptAsset;
const Asset& indexScript = indexScriptAsset;

namespace {

void replaceAll(std::string& text, const std::string& from, const std::string& to) {
    for (std::size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
}

/// The attribute's numbers with two digits behind the point, which is finer than any screen.
void shorten(std::string& svg, const std::string& attribute) {
    std::string result;
    bool inside = false;
    std::size_t decimals = 0;  // read of a number, its point included
    for (std::size_t i = 0; i < svg.size(); ++i) {
        if (!inside && svg.compare(i, attribute.size(), attribute) == 0) {
            result += attribute;
            i += attribute.size() - 1;
            inside = true;
            continue;
        }
        const char c = svg[i];
        const bool digit = c >= '0' && c <= '9';
        decimals = c == '.' ? 1 : digit && decimals > 0 ? decimals + 1 : 0;
        if (c == '"') inside = false;
        if (!inside || decimals <= 3) result += c;
    }
    svg = std::move(result);
}

/// Attributes in place of styles, which the policy of a page does not let in: fill="none" for style="fill:none;".
void spreadStyles(std::string& svg) {
    static constexpr std::string_view start = " style=\"";
    std::string result;
    std::size_t at = 0;
    for (std::size_t found; (found = svg.find(start, at)) != std::string::npos;) {
        result.append(svg, at, found - at);
        const std::size_t end = svg.find('"', found + start.size());
        for (std::size_t i = found + start.size(); i < end;) {
            const std::size_t colon = svg.find(':', i), next = std::min(svg.find(';', i), end);
            result += ' ' + svg.substr(i, colon - i) + "=\"" + svg.substr(colon + 1, next - colon - 1) + '"';
            i = next + 1;
        }
        at = end + 1;
    }
    svg = result.append(svg, at);
}

}  // namespace

std::string htmlPage(const std::string& title, const std::string& body, const Asset& script) {
    const auto allowed = [](const Asset& asset) { return "'sha256-" + std::string(asset.hash) + "'"; };
    return "<!doctype html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n"
           "<meta name=\"viewport\" content=\"width=device-width, initial-scale=1\">\n"
           "<meta http-equiv=\"Content-Security-Policy\" content=\"default-src 'none'; img-src data:; style-src " +
           allowed(style) + "; script-src " + allowed(script) +
           "; base-uri 'none'; form-action 'none'\">\n"
           "<meta name=\"color-scheme\" content=\"light dark\">\n<link rel=\"icon\" href=\"data:,\">\n<title>" +
           escaped(title) + "</title>\n<style>" + std::string(style.text) + "</style>\n</head>\n<body>\n" + body +
           "<script>" + std::string(script.text) + "</script>\n</body>\n</html>\n";
}

std::string factTable(const std::string& caption, const std::vector<std::pair<std::string, std::string>>& rows) {
    std::string table = "<table class=\"facts\"><caption>" + escaped(caption) + "</caption><tbody>\n";
    for (const auto& [name, text] : rows)
        table += "<tr><th scope=\"row\">" + escaped(name) + "</th><td>" + escaped(text) + "</td></tr>\n";
    return table + "</tbody></table>\n";
}

std::string inlineSvg(std::string svg, const std::string& prefix) {
    svg.erase(0, svg.find("<svg"));
    svg.insert(4, " role=\"img\" class=\"diagram\"");
    for (const std::string reference : {" id=\"", "href=\"#", "url(#"})
        replaceAll(svg, reference, reference + prefix);
    // What Cairo says of every path and browsers, or the style, know.
    for (const std::string known : {"fill-rule:nonzero;", "fill-opacity:1;", "stroke-opacity:1;",
                                    "stroke-linecap:butt;", "stroke-linejoin:round;", "stroke-miterlimit:10;"})
        replaceAll(svg, known, "");
    for (const std::string attribute : {" d=\"", " style=\""}) shorten(svg, attribute);
    spreadStyles(svg);
    return svg;
}

std::string urlPart(std::string_view text) {
    static constexpr std::string_view plain = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789-_.";
    static constexpr char digits[] = "0123456789ABCDEF";
    std::string url;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (plain.find(c) != std::string_view::npos) {
            url += c;
        } else {
            url += {'%', digits[byte >> 4], digits[byte & 15]};
        }
    }
    return url;
}

}  // namespace OvTool
