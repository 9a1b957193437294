// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <functional>

class QMenu;

namespace host {

/// The part of the menu "&Livro" that changes: the books used before, the present one ticked. It is
/// filled afresh each time the menu opens.
class BookMenu : public QObject {
    Q_OBJECT
public:
    /// @param choose  goes over to the book that `way` leads to; `way` is false when the person
    /// gave up
    BookMenu(QMenu* menu, const std::function<void(const std::function<bool()>& way)>& choose);

private:
    void fill();

    QMenu* menu_;
    std::function<void(const std::function<bool()>& way)> choose_;
};

}  // namespace host
