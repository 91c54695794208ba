// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>

/// The texts of the sample drive.
namespace host::drive::sample::texts {

extern const char* const toDo;
extern const char* const packingList;
extern const char* const lemonCake;
extern const char* const shakshuka;
extern const char* const plumDumplings;
extern const char* const ramen;
extern const char* const thesis;
extern const char* const references;
extern const char* const quicksort;
extern const char* const graphSearch;
extern const char* const sensorData;
extern const char* const htmlPage;
extern const char* const birthdayList;
extern const char* const arabicLetter;
extern const char* const arabicDates;
extern const char* const hebrewNotes;
extern const char* const japaneseNotes;
extern const char* const flatBudget;
extern const char* const climbingPlan;
extern const char* const readingNotes;
extern const char* const tripItinerary;
extern const char* const diary;

/// A lecture's notes, and a shop's receipt.
std::string lecture(int number);
std::string receipt(int number);

} // namespace host::drive::sample::texts
