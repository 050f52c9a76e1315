// Small pictures of models, kept in the person's cache.
#pragma once

#include <QPixmap>
#include <QSize>
#include <QString>

class CDBDoc;

inline constexpr QSize kThumbnailSize{216, 132}; // px at 96 dpi

/// The frame of a document, drawn for white paper; an empty model gives an empty sheet.
QPixmap DrawThumbnail(CDBDoc& doc);

/// The picture kept for a file; null: none, or one of before the file changed.
QPixmap KeptThumbnail(const QString& path);
/// Keeps a picture for a file that is there. A cache that can't be written is no fault.
void KeepThumbnail(const QString& path, const QPixmap& picture);

/// Reads a case file and draws it; null: it can't be read.
QPixmap DrawCaseThumbnail(const QString& path);
