// Writes a resource fork as the library's resource tree: every resource as ":/TYPE/nnnnn"
// (and ":/TYPE/name" for a plain name), icons and pictures as ":/images/TYPE_ID.png", and a
// .qrc listing them all.
#pragma once

#include "classic/resfile/ResourceFork.h"

#include <QString>
#include <QStringList>

namespace VelmarRez {

struct ExportReport {
    QStringList written;  // paths relative to the folder, as the .qrc lists them
    QStringList skipped;  // "TYPE ID: reason"
};

// Needs a QGuiApplication for the pictures. False (with a reason) when the folder or a file
// cannot be written.
bool exportTree(const Velmar::Classic::ResourceFork& fork, const QString& folder,
                ExportReport& report, QString* error);

// The file name GetResource reads for an ID: five digits after any sign.
QString idFileName(Velmar::SInt16 id);

} // namespace VelmarRez
