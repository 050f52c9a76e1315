// Writes a drawing to a picture file.
#pragma once

#include <QRectF>

#include <functional>
#include <string>

class QPainter;

/// Anything that can be drawn with a painter, with its size in px at 96 dpi.
struct T_DRAWING {
    std::function<void(QPainter&, const QRectF&)> draw;
    QSizeF size{960, 640};
    std::string title, subtitle; // kept in the file where its format can
};

/// Writes .svg, .pdf (both vector), .png, .jpg or .bmp (twice the screen size), told by the
/// extension in any case; a PDF is one page of the drawing's size. Needs no screen: without a
/// running Qt application it makes one for the call. Returns 1; or 0 with a text in `error` that
/// names the file: unknown extension, or the file can't be written. The file is replaced as a whole
/// or left as it was; nothing else stays behind. Numbers keep the C locale after the call.
[[nodiscard]] int WritePictureFile(const T_DRAWING& drawing, const std::string& path,
                                   std::string& error);

/// The drawing as the text of an SVG file.
std::string SvgText(const T_DRAWING& drawing);

/// Writes what `make` gives to a file, with a Qt application around it as above. 1 done; 0 error
/// names the file: nothing was made, there is no memory, or the file can't be written; it is then
/// as it was.
[[nodiscard]] int WriteOffscreen(const std::string& path, std::string& error,
                                 const std::function<std::string()>& make);
