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
    /// Called after every edit.
    virtual void searchQueryDidChange(SearchPresentation& search) = 0;
    /// The user left the search; it is dismissed already.
    virtual void searchWasCancelled(SearchPresentation&) { }
    /// The user moved the keyboard focus from the field down into the results, which may not have arrived
    /// yet.
    virtual void searchResultsWanted(SearchPresentation&) { }
    /// The user pressed the return key in the field. The results that the key was meant for may not have
    /// arrived yet.
    virtual void searchResultChosen(SearchPresentation&) { }
    /// The search is no longer shown. This comes however the search ended.
    virtual void searchDidDisappear(SearchPresentation&) { }
};

/// Calls down that only a search makes.
class SearchObserver {
public:
    virtual ~SearchObserver() = default;
    virtual void searchQueryWasSet(SearchPresentation& search) = 0;
    virtual void searchWantsFocus(SearchPresentation& search, bool focus) = 0;
};

/// A screen with a search field. It is presented over a list, and its view shows the results below the field.
/// The host recognises a search by this class.
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

    // Events up: the host reports what the user did.
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
