#pragma once

#include <functional>
#include <string>

#include "plot/canvas.h"

namespace OvPlot {

enum class PictureFormat { svg, png, pdf };

/// In pixels; a page of a PDF is as large as they are at 96 to the inch.
struct PictureSize {
    int width = 600;
    int height = 600;
};

/// Draws a picture; its bytes. `title` names it to programs that show it. Raises std::runtime_error where there is
/// no room for it.
std::string drawPicture(PictureFormat format, PictureSize size, const Palette& palette, const std::string& title,
                        const std::function<void(Canvas&)>& draw);

/// Text as it can stand in HTML and XML, in attributes too.
std::string escaped(std::string_view text);

}  // namespace OvPlot
