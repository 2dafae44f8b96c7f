#pragma once

#include <QString>

// The text of a printed PDF, page by page, with the page number that closes each page removed and
// all white space collapsed (pdftotext changes runs of spaces; layout is not the point).
QString printedText(const QString& pdf);
// The fonts a PDF uses, as pdffonts lists them.
QString pdfFonts(const QString& pdf);
