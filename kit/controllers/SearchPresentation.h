// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/ViewController.h"

namespace kit {

class SearchPresentation;

/// Is told what the user types into a search field.
class SearchPresentationDelegate {
public:
    virtual ~SearchPresentationDelegate() = default;
    /// After every edit.
    virtual void searchQueryDidChange(SearchPresentation& search) = 0;
    /// The user left the search; it is dismissed already.
    virtual void searchWasCancelled(SearchPresentation&) { }
    /// The keyboard goes down from the field into the results, which may still be on their way.
    virtual void searchResultsWanted(SearchPresentation&) { }
    /// The return key in the field, or before the results that it was meant for.
    virtual void searchResultChosen(SearchPresentation&) { }
    /// The search is not shown any more, for whatever reason.
    virtual void searchDidDisappear(SearchPresentation&) { }
};

/// Calls down that only a search makes.
class SearchObserver {
public:
    virtual ~SearchObserver() = default;
    virtual void searchQueryWasSet(SearchPresentation& search) = 0;
    virtual void searchWantsFocus(SearchPresentation& search, bool focus) = 0;
};

/// The search field with its results: presented over a list, its view shows the results below the field. A
/// presented screen is a search exactly when it is of this class.
class SearchPresentation : public ViewController {
public:
    SearchPresentation();

    void accept(ViewControllerVisitor& visitor) override;
    void setSearchObserver(std::weak_ptr<SearchObserver> observer)
    {
        _searchObserver.set(std::move(observer));
    }
    void setDelegate(std::weak_ptr<SearchPresentationDelegate> delegate) { _delegate = std::move(delegate); }

    const std::string& query() const { return _query; }
    void setQuery(std::string query); ///< tells the delegate as an edit does
    const std::string& placeholder() const { return _placeholder; }
    void setPlaceholder(std::string placeholder) { _placeholder = std::move(placeholder); }
    bool hasFocus() const { return _focus; }
    void setFocus(bool focus);

    // Events up.
    void userEditedQuery(std::string query);
    void userWentDown();
    void userPressedReturn();
    void userCancelled() override;

    void viewDidDisappear(bool animated) override;

private:
    std::weak_ptr<SearchPresentationDelegate> _delegate;
    ObserverSlot<SearchObserver> _searchObserver;
    std::string _query, _placeholder;
    bool _focus = false;
};

} // namespace kit
