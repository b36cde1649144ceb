#pragma once

#include <QSqlDatabase>
#include <QString>

namespace tessel::gallery {

/// A database of countries, their subdivisions and the world's languages, made of Debian's `iso-codes` on first use and kept in the
/// user's data folder: the tables `countries` and `languages` (`id`, `name`) and `subdivisions` (`id`, `name`, `country`).
/// Gives what went wrong, or the empty string.
QString OpenIsoCodes(QSqlDatabase& database);

}  // namespace tessel::gallery
