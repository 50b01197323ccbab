#pragma once

#include <QImage>
#include <QSizeF>
#include <QString>
#include <map>

namespace zorbin {

class FileSystem;

// A picture ready to draw.
struct PdfPicture
{
    QImage image;   // opaque (transparent parts on white), at most as large as the file's own pixels
    QSizeF natural; // the picture's size in points at 96 pixels an inch (a CSS pixel), upright
};

// The size at which a picture of `natural` size is drawn in a box: its own size when it fits,
// otherwise scaled down to fit without distortion (never enlarged, as the pages show pictures).
QSizeF fittedSize(const QSizeF &natural, const QSizeF &box);

// The pictures of one PDF run. Each distinct file is decoded once, upright (EXIF orientation
// applied), scaled while decoding to the largest box it is drawn in at `dotsPerInch` (never
// above its own pixels), flattened on white, and kept: drawing the one kept image each time lets
// the PDF hold it once however many items show it, until the run lets it go after its last item.
// A file that is missing or cannot be decoded gives no picture, once, and is not tried again.
class PdfPictures
{
public:
    // `box` is the largest box, in points, that a picture is drawn in during the run.
    PdfPictures(const FileSystem &files, QSizeF box, double dotsPerInch = 300);

    // The picture of a file; null when there is none. The picture stays where it is as long as
    // the object lives.
    const PdfPicture *picture(const QString &file);

    // Lets a file's picture go: the run will not draw it again.
    void release(const QString &file);

    int decoded() const { return m_decoded; }
    // The most pictures kept at once.
    int heldAtMost() const { return m_heldAtMost; }

private:
    const FileSystem &m_files;
    QSizeF m_box;
    double m_dotsPerInch;
    std::map<QString, PdfPicture> m_pictures; // a null image for a file that gave none
    int m_decoded = 0;
    int m_heldAtMost = 0;
};

} // namespace zorbin
