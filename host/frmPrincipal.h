// SPDX-License-Identifier: MIT
#pragma once

#include <QMainWindow>
#include <QVariant>

#include "host/BookSettings.h"
#include "host/Operations.h"

class QLabel;
class QMenu;
class QStackedWidget;

namespace host {

class BookPage;
class BookWatch;
class MovementsView;
class frmConta;

/// The window a person starts with: the movements in force, and a menu with every operation of the
/// component.
class frmPrincipal : public QMainWindow {
    Q_OBJECT
public:
    frmPrincipal();
    ~frmPrincipal() override;

    /// Called by the component after a movement was annulled: the list finds out which by the
    /// correcting row.
    Q_INVOKABLE void RemoteKey(const QVariant& movimento_id);

    /// Reads the settings and the book afresh.
    void reload();
    /// Runs an operation of the component; a failure is shown in a box. An entry under way is
    /// brought forward in place of an operation that would take its screen away. Nothing runs while
    /// an operation or its box is still open.
    void run(const OperationCall& call);

protected:
    bool event(QEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    void hideEvent(QHideEvent* event) override;

private:
    void addItem(QMenu* menu, const QString& name, const QString& caption, const QString& shortcut,
                 const std::function<void()>& handler);
    void addOperation(QMenu* menu, const QString& caption, const QString& shortcut,
                      const OperationCall& call, const QString& name = {});
    void connectBookPage();
    void addBookMenu();
    void addEntryMenu();
    void addListingMenus();
    void addYearMenus();
    void addOrderMenu(QMenu* menu);
    void addViewMenu();
    void addHelpMenu();
    void addStatusLine();

    void guardKeys();
    void runUnguarded(const OperationCall& call);
    void once(const std::function<void()>& handler);
    void inBook(const std::function<void()>& handler);
    void takeUnfit(const QString& why);
    void takeFound(const QStringList& findings);
    void tellWhyNot();
    void login();
    void goOver(const std::function<bool()>& way);
    void closeOtherWindows();
    void showPage(const BookSettings& settings);
    void checkBook();
    void showAccountOfMovement();
    void findMember();
    void showAccount(qint32 socio_id);
    void makeBankFile();
    void makeDocuments();
    void importFiles();
    void closeYear();
    void offerToFinish();
    void showCount(const QString& text);
    void restoreLook();
    void restoreFilter();
    void saveLook() const;

    bool isOffering_ = false;  ///< the question about unfinished operations is being asked
    Operations operations_;
    bool isRunning_ = false;
    QPointer<frmConta> account_;  ///< the member's page that is open; null for none
    QStackedWidget* pages_;       ///< the movements, or the ways to a book
    MovementsView* movements_;
    BookPage* books_;
    BookWatch* watch_;
    QLabel* count_;
    QLabel* findings_;
    QLabel* sample_;
    QLabel* book_;
    QLabel* user_;
};

}  // namespace host
