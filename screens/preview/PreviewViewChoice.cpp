// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewViewChoice.h"

#include "screens/preview/PreviewMediaView.h"
#include "screens/preview/PreviewPagesView.h"
#include "screens/preview/PreviewPictureView.h"
#include "screens/preview/PreviewTextView.h"

namespace screens {

namespace {

template <typename View>
std::shared_ptr<View> reused(const std::shared_ptr<PreviewView>& before)
{
    const auto same = std::dynamic_pointer_cast<View>(before);
    return same ? same : std::make_shared<View>();
}

std::shared_ptr<PreviewView> mediaView(
    const PreviewContent& content, const std::shared_ptr<PreviewView>& before)
{
    const auto view = reused<PreviewMediaView>(before);
    view->setMedia(
        {content.path, content.title, content.iconName, content.kind == PreviewContent::Kind::Film});
    return view;
}

std::shared_ptr<PreviewView> viewFor(
    const PreviewContent& content, const std::shared_ptr<PreviewView>& before)
{
    switch (content.kind) {
    case PreviewContent::Kind::Image: {
        const auto view = reused<PreviewPictureView>(before);
        view->setPicture(content.picture);
        return view;
    }
    case PreviewContent::Kind::Text: {
        const auto view = reused<PreviewTextView>(before);
        view->setText({content.text, content.fileName, content.isSource});
        return view;
    }
    case PreviewContent::Kind::Pages: {
        const auto view = reused<PreviewPagesView>(before);
        view->setDocument(content.pages, content.firstPage);
        return view;
    }
    case PreviewContent::Kind::Sound:
    case PreviewContent::Kind::Film:
        return mediaView(content, before);
    case PreviewContent::Kind::Summary:
    case PreviewContent::Kind::InCloud:
    case PreviewContent::Kind::Failure:
        break;
    }
    return nullptr;
}

} // namespace

std::shared_ptr<PreviewView> previewViewFor(
    const PreviewContent& content, const std::shared_ptr<PreviewView>& before)
{
    const auto view = viewFor(content, before);
    if (view)
        view->setAccessibilityLabel(content.title);
    return view;
}

} // namespace screens
