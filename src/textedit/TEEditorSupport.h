// What the editor widgets ask of their record.
#pragma once

#include <Velmar/TextEdit.h>

#include <QPalette>

namespace Velmar::Private {

// The editor is being destroyed (its window went): the record keeps `text`.
void editorGone(TEPtr* te, const QString& text);
// Calls the record's click loop; true to go on tracking (also without a loop), false once
// the loop says stop or the record is gone.
bool callClickLoop(TEPtr* te);
// The palette the editor paints with: the port's colours, or the host palette's eight.
QPalette recordPalette(const TEPtr* te, const QPalette& base);

} // namespace Velmar::Private
