// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/SearchPresentation.h"

#include "kit/controllers/ViewControllerVisitor.h"

namespace kit {

SearchPresentation::SearchPresentation()
{
    setPresentationStyle(PresentationStyle::OverCurrentContext);
}

void SearchPresentation::accept(ViewControllerVisitor& visitor)
{
    visitor.visit(*this);
}

void SearchPresentation::setQuery(std::string query)
{
    if (query == _query)
        return;
    _query = std::move(query);
    _searchObserver.notify([this](SearchObserver& observer) { observer.searchQueryWasSet(*this); });
    if (const auto delegate = _delegate.lock())
        delegate->searchQueryDidChange(*this);
}

void SearchPresentation::setFocus(bool focus)
{
    _focus = focus;
    _searchObserver.notify([&](SearchObserver& observer) { observer.searchWantsFocus(*this, focus); });
}

void SearchPresentation::userEditedQuery(std::string query)
{
    if (query == _query)
        return;
    _query = std::move(query);
    if (const auto delegate = _delegate.lock())
        delegate->searchQueryDidChange(*this);
}

void SearchPresentation::userWentDown()
{
    if (const auto delegate = _delegate.lock())
        delegate->searchResultsWanted(*this);
}

void SearchPresentation::userPressedReturn()
{
    if (const auto delegate = _delegate.lock())
        delegate->searchResultChosen(*this);
}

void SearchPresentation::userCancelled()
{
    const auto self = std::static_pointer_cast<SearchPresentation>(shared_from_this());
    dismissViewController(true);
    if (const auto delegate = _delegate.lock())
        delegate->searchWasCancelled(*self);
}

void SearchPresentation::viewDidDisappear(bool animated)
{
    ViewController::viewDidDisappear(animated);
    if (const auto told = _delegate.lock())
        told->searchDidDisappear(*this);
}

} // namespace kit
