#pragma once

#include <QString>
#include <QStringList>

namespace kora {

// The page of the guide, with the place on it, for a form by its objectName
// ("charts.html#keys"); the first page for a form that has none.
QString HelpPageOf(const QString& form);
bool HasHelpPage(const QString& form);
// The forms that have one, by name.
QStringList FormsOfTheGuide();

}  // namespace kora
