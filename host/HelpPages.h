// SPDX-License-Identifier: MIT
#pragma once

#include <QHash>
#include <QString>
#include <QUrl>

namespace host {

/// Which page of the manual tells of a screen: the screen's name to the page's file below
/// docs/manual/. Reports whose preview has no line here are told of by the page about previews.
const QHash<QString, QString>& helpPages();

/// The page for a screen; the contents for one that no page tells of.
QUrl helpPage(const QString& screen);
/// The contents of the manual.
QUrl helpContents();
/// The list of all keys.
QUrl helpKeys();

/// Where pictures of the manual may lie: with the documents of an installed program, or with those
/// that were built beside this one. The manual can be read without them.
QStringList helpPictureFolders();

}  // namespace host
