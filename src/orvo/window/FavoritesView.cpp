#include "orvo/window/private/FavoritesView.h"

#include "orvo/window/WindowTexts.h"
#include "orvo/window/private/MarkList.h"

#include <QAction>
#include <QHBoxLayout>
#include <QIcon>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QScrollBar>
#include <QStackedWidget>
#include <QToolButton>
#include <QVBoxLayout>

#include <algorithm>

namespace orvo {

namespace {

constexpr int Around = 16;
constexpr int Between = 10;
constexpr int Width = 440;
constexpr int Height = 540;

QString words(const std::string& key) {
    return QString::fromStdString(WindowTexts::text(key));
}

QString said(const std::string& text) {
    return QString::fromStdString(text);
}

} // namespace

FavoritesView::FavoritesView() {
    setWindowTitle(words("Favorites_Title"));
    makeParts();
    arrangeParts();
    connectParts();
}

void FavoritesView::makeParts() {
    _delegate = new MarkDelegate(this);
    _search = new QLineEdit;
    _search->setPlaceholderText(words("Search"));
    _search->setAccessibleName(words("Search"));
    _search->setClearButtonEnabled(true);
    for (auto* const button : _search->findChildren<QToolButton*>())
        button->setAccessibleName(words("Search_Clear"));
    // Its picture is of the looks.
    auto* const magnifier = _search->addAction(QIcon(), QLineEdit::LeadingPosition);
    magnifier->setText(words("Search"));
    connect(magnifier, &QAction::triggered, _search, [search = _search] { search->setFocus(); });
    _list = new MarkList(_delegate, words("Favorites_List"));
    _list->setDragDropMode(QAbstractItemView::InternalMove);
    _list->setDefaultDropAction(Qt::MoveAction);
    _results = new MarkList(_delegate, words("Search_Results"));
    _emptyTitle = new QLabel(words("Favorites_None"));
    _emptyText = new QLabel(words("Favorites_NoneText"));
    _noResults = new QLabel;
    _message = new QLabel;
    for (QLabel* const label : {_emptyTitle, _emptyText, _noResults, _message}) {
        label->setTextFormat(Qt::PlainText);
        label->setWordWrap(true);
    }
    for (QLabel* const label : {_emptyTitle, _emptyText, _noResults})
        label->setAlignment(Qt::AlignHCenter);
    _message->setTextInteractionFlags(Qt::TextSelectableByMouse);
    _undo = new QPushButton(words("Undo"));
    _undo->setShortcut(QKeySequence::Undo);
    _up = new QPushButton(words("MoveUp"));
    _down = new QPushButton(words("MoveDown"));
    _remove = new QPushButton(words("Remove"));
    for (QPushButton* const button : {_undo, _up, _down, _remove})
        button->setAutoDefault(false);
}

void FavoritesView::arrangeParts() {
    auto* const buttons = new QHBoxLayout;
    buttons->addWidget(_up);
    buttons->addWidget(_down);
    buttons->addStretch(1);
    buttons->addWidget(_remove);
    _listPage = new QWidget;
    auto* const listLayout = new QVBoxLayout(_listPage);
    listLayout->setContentsMargins(0, 0, 0, 0);
    listLayout->setSpacing(Between);
    listLayout->addWidget(_list, 1);
    listLayout->addLayout(buttons);

    _emptyPage = new QWidget;
    auto* const emptyLayout = new QVBoxLayout(_emptyPage);
    emptyLayout->addStretch(2);
    emptyLayout->addWidget(_emptyTitle);
    emptyLayout->addWidget(_emptyText);
    emptyLayout->addStretch(3);

    _resultsPage = new QWidget;
    auto* const resultsLayout = new QVBoxLayout(_resultsPage);
    resultsLayout->setContentsMargins(0, 0, 0, 0);
    resultsLayout->addWidget(_results, 1);
    resultsLayout->addStretch(0);
    resultsLayout->addWidget(_noResults);
    resultsLayout->addStretch(0);

    _pages = new QStackedWidget;
    for (QWidget* const page : {_listPage, _emptyPage, _resultsPage})
        _pages->addWidget(page);
    _footer = new QWidget;
    auto* const footerLayout = new QHBoxLayout(_footer);
    footerLayout->setContentsMargins(0, 0, 0, 0);
    footerLayout->addWidget(_message, 1);
    footerLayout->addWidget(_undo);

    auto* const layout = new QVBoxLayout(this);
    layout->setContentsMargins(Around, Around, Around, Around);
    layout->setSpacing(Between);
    layout->addWidget(_search);
    layout->addWidget(_pages, 1);
    layout->addWidget(_footer);
    _footer->hide();
}

void FavoritesView::connectParts() {
    connect(_search, &QLineEdit::textChanged, this, [this] { showResults(); });
    connect(_results, &QListWidget::itemActivated, this, [this](QListWidgetItem* item) {
        addResult(item);
    });
    connect(_results, &QListWidget::itemClicked, this, [this](QListWidgetItem* item) {
        addResult(item);
    });
    connect(_list, &QListWidget::itemSelectionChanged, this, [this] { updateButtons(); });
    connect(_list->model(),
            &QAbstractItemModel::rowsMoved,
            this,
            [this](const QModelIndex&, int from, int, const QModelIndex&, int before) {
                // Where it is going is told as the row before which it was put.
                dropped(from, before > from ? before - 1 : before);
            });
    connect(_up, &QPushButton::clicked, this, [this] { move(-1); });
    connect(_down, &QPushButton::clicked, this, [this] { move(1); });
    connect(_remove, &QPushButton::clicked, this, [this] { removeChosen(); });
    connect(_undo, &QPushButton::clicked, this, [this] { undoRemoval(); });
    for (QWidget* const part : {static_cast<QWidget*>(_search),
                                static_cast<QWidget*>(_results),
                                static_cast<QWidget*>(_list)})
        part->installEventFilter(this);
}

void FavoritesView::edit(std::shared_ptr<FavoritesEditor> favorites) {
    _editor = std::move(favorites);
    _search->clear();
    _footer->hide();
    reload();
    _search->setFocus();
}

void FavoritesView::setLooks(const WindowLooks& looks) {
    _looks = looks;
    _delegate->setLooks(looks);
    for (QAction* const action : _search->actions())
        action->setIcon(WindowLooks::magnifier(looks.secondary, devicePixelRatioF()));
    _emptyTitle->setFont(WindowLooks::font(1.15, QFont::DemiBold));
    QPalette faint;
    faint.setColor(QPalette::WindowText, looks.secondary);
    for (QLabel* const label : {_emptyText, _noResults})
        label->setPalette(faint);
    _list->viewport()->update();
    _results->viewport()->update();
}

QSize FavoritesView::sizeHint() const {
    return {Width, Height};
}

bool FavoritesView::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::KeyPress)
        return QWidget::eventFilter(watched, event);
    const auto& key = *static_cast<QKeyEvent*>(event);
    return (watched == _search && keyInSearch(key)) || (watched == _results && keyInResults(key)) ||
           (watched == _list && keyInList(key));
}

bool FavoritesView::keyInSearch(const QKeyEvent& event) {
    const bool hasResults = _pages->currentWidget() == _resultsPage && _results->count() > 0;
    if (event.matches(QKeySequence::Undo) && _search->text().isEmpty()) {
        undoRemoval();
        return true;
    }
    switch (event.key()) {
    case Qt::Key_Escape:
        if (_search->text().isEmpty())
            return false;
        _search->clear();
        return true;
    case Qt::Key_Down:
        if (!hasResults) {
            if (_pages->currentWidget() == _listPage)
                _list->setFocus();
            return true;
        }
        _results->setFocus();
        _results->setCurrentRow(std::min(1, _results->count() - 1));
        return true;
    case Qt::Key_Return:
    case Qt::Key_Enter:
        if (hasResults)
            addResult(_results->currentItem());
        return true;
    default:
        return false;
    }
}

bool FavoritesView::keyInResults(const QKeyEvent& event) {
    const bool isUpFromTop = event.key() == Qt::Key_Up && _results->currentRow() <= 0;
    if (event.key() != Qt::Key_Escape && !isUpFromTop)
        return false;
    if (event.key() == Qt::Key_Escape)
        _search->clear();
    _search->setFocus();
    return true;
}

bool FavoritesView::keyInList(const QKeyEvent& event) {
    const bool withAlt = event.modifiers().testFlag(Qt::AltModifier);
    if (withAlt && (event.key() == Qt::Key_Up || event.key() == Qt::Key_Down)) {
        move(event.key() == Qt::Key_Up ? -1 : 1);
        return true;
    }
    if (event.key() == Qt::Key_Delete || event.key() == Qt::Key_Backspace) {
        removeChosen();
        return true;
    }
    return false;
}

void FavoritesView::changeEvent(QEvent* event) {
    // Another program may have changed them while the person was there.
    if (event->type() == QEvent::ActivationChange && isActiveWindow() && _editor)
        reload();
    QWidget::changeEvent(event);
}

void FavoritesView::keyPressEvent(QKeyEvent* event) {
    if (event->matches(QKeySequence::Find)) {
        _search->setFocus();
        _search->selectAll();
    } else if (event->key() == Qt::Key_Escape || event->matches(QKeySequence::Close)) {
        window()->close();
    } else {
        QWidget::keyPressEvent(event);
    }
}

void FavoritesView::reload() {
    const auto chosen = static_cast<std::size_t>(std::max(0, _list->currentRow()));
    if (const auto error = _editor->reload())
        say(error, {});
    showFavorites(chosen);
}

void FavoritesView::showFavorites(std::size_t chosen) {
    _isFilling = true;
    const int scrolled = _list->verticalScrollBar()->value();
    _list->clear();
    for (const auto& mark : _editor->favorites())
        _list->addMark(mark, {});
    _list->setCurrentRow(std::min(static_cast<int>(chosen), _list->count() - 1));
    _list->verticalScrollBar()->setValue(scrolled);
    if (_list->currentItem())
        _list->scrollToItem(_list->currentItem());
    _isFilling = false;
    updateButtons();
    showResults();
}

void FavoritesView::showResults() {
    if (!_editor)
        return;
    const auto text = _search->text().trimmed();
    if (text.isEmpty()) {
        _results->clear(); // assistive tools are told of pages that are not shown, too
        _pages->setCurrentWidget(_list->count() > 0 ? _listPage : _emptyPage);
        return;
    }
    const auto found = _editor->search(text.toStdString());
    _results->clear();
    for (const auto& result : found.lines)
        _results->addMark(result.line, result.isFavorite ? words("Search_IsFavorite") : QString());
    _results->setCurrentRow(0);
    _results->setVisible(!found.lines.empty());
    _noResults->setVisible(found.lines.empty());
    if (found.error)
        _noResults->setText(said(found.error->localizedDescription()));
    else if (!found.hasSchedules)
        _noResults->setText(words("Search_NoSchedules"));
    else
        _noResults->setText(said(WindowTexts::text("Search_None", text.toStdString())));
    _pages->setCurrentWidget(_resultsPage);
}

void FavoritesView::updateButtons() {
    const int row = _list->currentRow();
    _up->setEnabled(row > 0);
    _down->setEnabled(row >= 0 && row + 1 < _list->count());
    _remove->setEnabled(row >= 0);
}

void FavoritesView::addResult(QListWidgetItem* item) {
    if (!item)
        return;
    const auto mark = MarkList::markOf(*item);
    const bool isThere = _editor->indexOfLine(mark.muid) < _editor->favorites().size();
    const auto error = _editor->add(mark.muid);
    say(error, WindowTexts::text(isThere ? "AlreadyAdded" : "Added", mark.title));
    if (error) {
        showFavorites(0);
        return;
    }
    const auto place = _editor->indexOfLine(mark.muid);
    // The list and its new row, ready for the next search.
    _search->clear();
    showFavorites(place);
    _search->setFocus();
}

void FavoritesView::move(int by) {
    const int from = _list->currentRow();
    const int to = from + by;
    if (from < 0 || to < 0 || to >= _list->count())
        return;
    say(_editor->move(static_cast<std::size_t>(from), static_cast<std::size_t>(to)), {});
    showFavorites(static_cast<std::size_t>(to));
}

void FavoritesView::dropped(int from, int to) {
    if (_isFilling || from == to)
        return;
    say(_editor->move(static_cast<std::size_t>(from), static_cast<std::size_t>(to)), {});
    // Not while the list is still at the drop.
    QMetaObject::invokeMethod(
        this, [this, to] { showFavorites(static_cast<std::size_t>(to)); }, Qt::QueuedConnection);
}

void FavoritesView::removeChosen() {
    const int row = _list->currentRow();
    if (row < 0)
        return;
    const auto title = MarkList::markOf(*_list->currentItem()).title;
    say(_editor->remove(static_cast<std::size_t>(row)), WindowTexts::text("Removed", title));
    showFavorites(static_cast<std::size_t>(row));
}

void FavoritesView::undoRemoval() {
    say(_editor->undoRemoval(), {});
    showFavorites(static_cast<std::size_t>(std::max(0, _list->currentRow())));
}

void FavoritesView::say(const std::shared_ptr<NSError>& error, const std::string& message) {
    QPalette palette;
    palette.setColor(QPalette::WindowText, error ? _looks.advisory : _looks.secondary);
    _message->setPalette(palette);
    _message->setText(said(error ? error->localizedDescription() : message));
    _undo->setVisible(_editor->canUndoRemoval());
    _footer->setVisible(!_message->text().isEmpty() || _editor->canUndoRemoval());
}

} // namespace orvo
