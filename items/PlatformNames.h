// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Attributes.h"
#include "platform/CloudDocumentService.h"
#include "platform/Error.h"
#include "platform/Formatters.h"
#include "platform/Log.h"
#include "platform/Services.h"

/// The program uses the names of the platform's values without a prefix.
namespace tarrow {

using platform::AttributeKey;
using platform::AttributeKeys;
using platform::AttributeMap;
using platform::AttributeValue;
using platform::Date;
using platform::DateStyle;
using platform::DocumentContainer;
using platform::Error;
using platform::FileErrorCode;
using platform::Image;
using platform::Operation;
using platform::PropertyArray;
using platform::PropertyDictionary;
using platform::PropertyValue;
using platform::Result;
using platform::ThumbnailMap;
using platform::Url;

using platform::services;

} // namespace tarrow
