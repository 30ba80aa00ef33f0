#pragma once

#include "orvo/window/FavoritesEditor.h"
#include "orvo/window/private/MarkDelegate.h"
#include "orvo/window/private/WindowLooks.h"

#include <QWidget>

#include <memory>

class QLabel;
class QLineEdit;
class QListWidgetItem;
class QPushButton;
class QStackedWidget;

namespace orvo {

class MarkList;

/// The favourites in a window: a field that finds lines and adds them, and the list, whose order
/// the person changes by dragging or with Alt and the arrow keys. What is removed can be brought
/// back. Whatever goes wrong is said below the list.
class FavoritesView final : public QWidget {
public:
    FavoritesView();

    /// Reads them, and shows them. Not nil.
    void edit(std::shared_ptr<FavoritesEditor> favorites);
    void setLooks(const WindowLooks& looks);

    [[nodiscard]] QSize sizeHint() const override;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void changeEvent(QEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    void makeParts();
    void arrangeParts();
    void connectParts();

    [[nodiscard]] bool keyInSearch(const QKeyEvent& event);
    [[nodiscard]] bool keyInResults(const QKeyEvent& event);
    [[nodiscard]] bool keyInList(const QKeyEvent& event);

    void reload();
    /// Shows what the editor has, with that row chosen as far as there is one.
    void showFavorites(std::size_t chosen);
    void showResults();
    void updateButtons();
    void addResult(QListWidgetItem* item);
    void move(int by);
    void dropped(int from, int to);
    void removeChosen();
    void undoRemoval();
    /// Says it below the list: the error where there is one, else the message.
    void say(const std::shared_ptr<NSError>& error, const std::string& message);

    std::shared_ptr<FavoritesEditor> _editor;
    WindowLooks _looks;
    QLineEdit* _search = nullptr;
    QStackedWidget* _pages = nullptr;
    QWidget* _listPage = nullptr;
    QWidget* _emptyPage = nullptr;
    QWidget* _resultsPage = nullptr;
    QLabel* _emptyTitle = nullptr;
    QLabel* _emptyText = nullptr;
    QLabel* _noResults = nullptr;
    MarkList* _list = nullptr;
    MarkList* _results = nullptr;
    QLabel* _message = nullptr;
    QPushButton* _undo = nullptr;
    QPushButton* _up = nullptr;
    QPushButton* _down = nullptr;
    QPushButton* _remove = nullptr;
    QWidget* _footer = nullptr;
    MarkDelegate* _delegate = nullptr;
    bool _isFilling = false; ///< the list is being filled, and nobody drags
};

} // namespace orvo
