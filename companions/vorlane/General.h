// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <memory>

namespace vorlane {

class frmProgresso;

/// "Vorlane.General": the progress window. Members called out of order do nothing.
class General : public QObject {
    Q_OBJECT
public:
    General();
    ~General() override;

    /// Opens the window with the bar at 0 of `total` steps; a window already open starts anew. In a
    /// program without screens there is none.
    Q_INVOKABLE void Iniciar(qint16 total, const QString& message, const QString& title);

    /// Advances the bar by that number of steps, never past the total nor back below 0.
    Q_INVOKABLE void setvalor(qint16 steps);

    /// Closes the window.
    Q_INVOKABLE void terminar();

private:
    std::unique_ptr<frmProgresso> window_;
};

}  // namespace vorlane
