#include "orvo/window/private/FavoritesView.h"

#include "orvo/window/WindowWorld.h"

#include <QAccessible>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMouseEvent>
#include <QPushButton>

namespace orvo {
namespace {

class FavoritesViewTest : public testing::WindowTest {
protected:
    void SetUp() override {
        ASSERT_TRUE(testing::haveWindowApplication());
        importCity();
        view.emplace();
        editor = std::make_shared<FavoritesEditor>(
            [this](FavoritesStore::Access access, std::shared_ptr<NSError>& error) {
                if (access == FavoritesStore::Access::Write && failure) {
                    error = failure;
                    return std::shared_ptr<FavoritesStore>();
                }
                return FavoritesStore::open(FavoritesStore::standardPath(), access, &error);
            });
        for (const char* route : {"M1", "T4", "T7"})
            ASSERT_FALSE(editor->add(lineMuid("city", route)));
        view->setLooks(WindowLooks::of({}));
        view->edit(editor);
        view->show();
        lists = view->findChildren<QListWidget*>();
        for (auto* list : lists)
            (list->dragDropMode() == QAbstractItemView::InternalMove ? favorites : results) = list;
        search = view->findChild<QLineEdit*>();
    }

    static std::string namesIn(const QListWidget& list) {
        std::string names;
        for (int i = 0; i < list.count(); ++i)
            names += (i > 0 ? " " : "") +
                     list.item(i)->data(MarkDelegate::MarkRole).value<LineMark>().name;
        return names;
    }
    /// What is kept, read anew.
    std::string kept() const {
        EXPECT_FALSE(editor->reload());
        std::string names;
        for (const auto& mark : editor->favorites())
            names += (names.empty() ? "" : " ") + mark.name;
        return names;
    }

    static void press(QWidget* part, int key, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
        QKeyEvent event(QEvent::KeyPress, key, modifiers);
        QCoreApplication::sendEvent(part, &event);
        QCoreApplication::processEvents();
    }
    void click(const char* words) const {
        for (auto* button : view->findChildren<QPushButton*>()) {
            if (button->text() == words && button->isVisible())
                return button->click();
        }
        FAIL() << "there is no button " << words;
    }
    bool says(const char* words) const {
        for (const auto* label : view->findChildren<QLabel*>()) {
            if (label->isVisible() && label->text().contains(words))
                return true;
        }
        return false;
    }

    std::shared_ptr<NSError> failure;
    std::shared_ptr<FavoritesEditor> editor;
    std::optional<FavoritesView> view;
    QList<QListWidget*> lists;
    QListWidget* favorites = nullptr;
    QListWidget* results = nullptr;
    QLineEdit* search = nullptr;
};

TEST_F(FavoritesViewTest, ListsThemInTheirOrder) {
    EXPECT_EQ(view->windowTitle(), "Favorite lines");
    EXPECT_EQ(namesIn(*favorites), "M1 4 7");
    EXPECT_EQ(favorites->item(0)->data(Qt::AccessibleTextRole).toString(),
              "M1, Airport – Old Harbour, Marrow Bay Transit");
}

TEST_F(FavoritesViewTest, TheFirstLineThatIsFoundIsAddedByReturn) {
    search->setText("12");
    ASSERT_GT(results->count(), 0);
    EXPECT_TRUE(results->isVisible());
    press(search, Qt::Key_Return);
    EXPECT_EQ(search->text(), "");
    EXPECT_EQ(namesIn(*favorites), "M1 4 7 12");
    EXPECT_EQ(favorites->currentRow(), 3);
    EXPECT_EQ(kept(), "M1 4 7 12");
    EXPECT_TRUE(says("was added."));
}

TEST_F(FavoritesViewTest, AFavoriteThatIsFoundIsMarkedAndNotAddedTwice) {
    search->setText("M1");
    ASSERT_GT(results->count(), 0);
    EXPECT_EQ(results->item(0)->data(MarkDelegate::NoteRole).toString(), "Favorite");
    press(search, Qt::Key_Return);
    EXPECT_EQ(kept(), "M1 4 7");
    EXPECT_TRUE(says("is a favorite already."));
}

TEST_F(FavoritesViewTest, AssistiveToolsAreToldOfNothingFoundOnceTheSearchFieldIsEmpty) {
    auto* const told = QAccessible::queryAccessibleInterface(results);
    ASSERT_TRUE(told);
    const auto rowsToldOf = [&](const char* text) {
        search->setText(text);
        return told->childCount();
    };
    EXPECT_EQ(rowsToldOf(""), 0);
    EXPECT_GT(rowsToldOf("12"), 0);
    EXPECT_EQ(rowsToldOf(""), 0);
    EXPECT_GT(rowsToldOf("M1"), 0);
    EXPECT_EQ(rowsToldOf("  "), 0);
    EXPECT_EQ(results->count(), 0);
    search->setText("12");
    press(search, Qt::Key_Return);
    EXPECT_EQ(told->childCount(), 0) << "adding a line empties the field";
}

TEST_F(FavoritesViewTest, ALineThatIsClickedIsAddedAndNothingFoundIsLeft) {
    search->setText("12");
    ASSERT_GT(results->count(), 0);
    const QPointF point = results->visualItemRect(results->item(0)).center();
    for (const auto type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease}) {
        QMouseEvent event(type, point, point, Qt::LeftButton, Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(results->viewport(), &event);
    }
    EXPECT_EQ(kept(), "M1 4 7 12");
    EXPECT_EQ(results->count(), 0);
}

TEST_F(FavoritesViewTest, ASearchThatFindsNothingSaysSo) {
    search->setText("no such line");
    EXPECT_TRUE(says("No line matches “no such line”."));
    press(search, Qt::Key_Escape);
    EXPECT_TRUE(favorites->isVisible());
}

TEST_F(FavoritesViewTest, AltWithAnArrowMovesTheChosenOne) {
    favorites->setCurrentRow(2);
    press(favorites, Qt::Key_Up, Qt::AltModifier);
    EXPECT_EQ(namesIn(*favorites), "M1 7 4");
    EXPECT_EQ(favorites->currentRow(), 1);
    press(favorites, Qt::Key_Down, Qt::AltModifier);
    press(favorites, Qt::Key_Down, Qt::AltModifier); // it is the last now
    EXPECT_EQ(namesIn(*favorites), "M1 4 7");
    EXPECT_EQ(kept(), "M1 4 7");
}

TEST_F(FavoritesViewTest, ButtonsMoveToo) {
    favorites->setCurrentRow(0);
    click("Move Down");
    EXPECT_EQ(kept(), "4 M1 7");
    click("Move Up");
    EXPECT_EQ(kept(), "M1 4 7");
}

TEST_F(FavoritesViewTest, ARowThatIsDraggedStaysWhereItIsDropped) {
    // As the list itself moves the row at a drop: before the row of that index.
    ASSERT_TRUE(favorites->model()->moveRow({}, 0, {}, 3));
    QCoreApplication::processEvents();
    EXPECT_EQ(kept(), "4 7 M1");
    ASSERT_TRUE(favorites->model()->moveRow({}, 2, {}, 1));
    QCoreApplication::processEvents();
    EXPECT_EQ(kept(), "4 M1 7");
    EXPECT_EQ(namesIn(*favorites), "4 M1 7");
}

TEST_F(FavoritesViewTest, DeleteRemovesAndUndoBringsBack) {
    favorites->setCurrentRow(1);
    press(favorites, Qt::Key_Delete);
    EXPECT_EQ(kept(), "M1 7");
    EXPECT_TRUE(says("was removed."));
    click("Undo");
    EXPECT_EQ(namesIn(*favorites), "M1 4 7");
    EXPECT_EQ(kept(), "M1 4 7");
    EXPECT_FALSE(says("was removed."));
}

TEST_F(FavoritesViewTest, ControlZInTheEmptySearchFieldBringsBackToo) {
    click("Remove");
    EXPECT_EQ(kept(), "4 7");
    press(search, Qt::Key_Z, Qt::ControlModifier);
    EXPECT_EQ(kept(), "M1 4 7");
}

TEST_F(FavoritesViewTest, WithoutAnyItSaysWhereToBegin) {
    for (int i = 0; i < 3; ++i)
        click("Remove");
    EXPECT_TRUE(says("No favorite lines yet"));
    EXPECT_TRUE(says("Search for a line above"));
}

TEST_F(FavoritesViewTest, WhatCouldNotBeKeptIsSaidAndTheListIsAsItWas) {
    failure = favoritesError(FavoritesError::CannotWrite, "The disk is full.");
    favorites->setCurrentRow(1);
    press(favorites, Qt::Key_Delete);
    EXPECT_TRUE(says("The disk is full."));
    EXPECT_EQ(namesIn(*favorites), "M1 4 7");
    ASSERT_TRUE(favorites->model()->moveRow({}, 0, {}, 3));
    QCoreApplication::processEvents();
    EXPECT_EQ(namesIn(*favorites), "M1 4 7");
}

} // namespace
} // namespace orvo
