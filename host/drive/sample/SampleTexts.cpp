// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/sample/SampleTexts.h"

namespace host::drive::sample::texts {

const char* const toDo = R"(TO DO

[x] Return library books (due Friday)
[x] Pay the electricity bill
[ ] Print the train tickets
[ ] Ask Jonas about the climbing weekend
[ ] Buy plums for grandma's dumplings
[ ] Send the thesis outline to Prof. Okafor
)";

const char* const packingList = R"(# Packing list – Tuscany

## Clothes
- 5 T-shirts, 1 warm sweater for the evenings
- hiking shoes, sandals
- swimwear and a towel

## Papers
- [x] train tickets (see *Documents/Tickets*)
- [x] insurance card
- [ ] youth hostel booking

## Do not forget
1. charger
2. sunscreen
3. the good coffee pot
)";

const char* const lemonCake = R"(# Lemon cake

*For a loaf tin of 28 cm · 15 minutes of work, 50 minutes in the oven*

| Ingredient | Amount |
| --- | --- |
| soft butter | 200 g |
| sugar | 180 g |
| eggs | 4 |
| flour | 250 g |
| baking powder | 2 tsp |
| lemons | 2 |

1. Heat the oven to **175 °C** and butter the tin.
2. Beat the butter with the sugar until it is pale; add the eggs one by one.
3. Fold in the flour, the baking powder, the zest of both lemons and the juice of one.
4. Bake for 50 minutes. Prick the warm cake and pour the juice of the second lemon, stirred with
   80 g of icing sugar, over it.

> Keeps fresh for three days, if nobody finds it.
)";

const char* const shakshuka = R"(# Shakshuka for two

- 2 onions, 1 red pepper, 2 cloves of garlic
- 1 tin of tomatoes
- 1 tsp cumin, 1 tsp sweet paprika, a pinch of chilli
- 4 eggs, parsley, feta

Soften onions and pepper in olive oil for ten minutes. Add garlic and spices, then the tomatoes, and
let it thicken. Make four hollows, break the eggs into them, cover and wait six minutes.
)";

const char* const plumDumplings = R"(GRANDMA'S PLUM DUMPLINGS

1 kg floury potatoes, boiled in their skins the day before
200 g flour, 50 g semolina, 1 egg, salt
12 plums, 12 sugar lumps
breadcrumbs, butter, cinnamon, sugar

Press the potatoes, knead with flour, semolina, egg and salt.
Put a sugar lump in the place of each stone, wrap in dough.
Simmer for 12 minutes - they swim when they are ready.
Roll in buttered crumbs. Never count how many you eat.
)";

const char* const ramen = R"(# Quick miso ramen

1. Fry ginger, garlic and spring onions in sesame oil.
2. Stir in 2 tbsp miso and 1 tbsp tahini, pour on 700 ml of stock.
3. Cook the noodles *separately*.
4. Top with a soft egg, corn, nori and chilli oil.
)";

const char* const thesis = R"(# Shortest paths in changing networks

**Draft 4** · Mira Keller · Department of Computer Science

## 1 Introduction

Timetables change while travellers are on their way. A route that was shortest when they left may not be
shortest when they arrive at the first junction. This thesis asks how much of an earlier answer can be
kept when a single edge of the network changes.

## 2 Preliminaries

Let *G = (V, E, w)* be a directed graph with non-negative weights. For a source *s* we write *d(v)* for
the length of a shortest path from *s* to *v*.

### 2.1 Updates

An update replaces the weight of one edge. We distinguish *increases* and *decreases*; deleting an edge
is an increase to infinity.

## 3 A lazy repair algorithm

```python
def repair(graph, dist, edge, weight):
    graph[edge] = weight
    queue = [edge.target]
    while queue:
        node = queue.pop()
        best = min(dist[p] + graph[p, node] for p in graph.before(node))
        if best != dist[node]:
            dist[node] = best
            queue.extend(graph.after(node))
```

## 4 Open questions

- Can the queue be ordered so that no node is looked at twice?
- How do real timetables differ from random graphs? See Figure 1.
)";

const char* const references = R"(@article{dijkstra1959,
  author  = {Edsger W. Dijkstra},
  title   = {A note on two problems in connexion with graphs},
  journal = {Numerische Mathematik},
  volume  = {1},
  pages   = {269--271},
  year    = {1959}
}

@article{hart1968,
  author  = {Peter E. Hart and Nils J. Nilsson and Bertram Raphael},
  title   = {A formal basis for the heuristic determination of minimum cost paths},
  journal = {IEEE Transactions on Systems Science and Cybernetics},
  year    = {1968}
}
)";

const char* const quicksort = R"(#include <algorithm>
#include <iostream>
#include <vector>

// Exercise 3: sort in place, the middle element as the pivot.
template <typename Iterator>
void quicksort(Iterator first, Iterator last)
{
    if (last - first < 2)
        return;
    const auto pivot = *(first + (last - first) / 2);
    const auto middle = std::partition(first, last, [&](const auto& x) { return x < pivot; });
    const auto upper = std::partition(middle, last, [&](const auto& x) { return !(pivot < x); });
    quicksort(first, middle);
    quicksort(upper, last);
}

int main()
{
    std::vector<int> numbers{5, 3, 9, 1, 7, 3, 8};
    quicksort(numbers.begin(), numbers.end());
    for (int number : numbers)
        std::cout << number << ' ';
    std::cout << '\n';
}
)";

const char* const graphSearch = R"("""Breadth-first search on the city's tram map."""
from collections import deque


def route(lines, start, goal):
    queue, before = deque([start]), {start: None}
    while queue:
        stop = queue.popleft()
        if stop == goal:
            path = []
            while stop is not None:
                path.append(stop)
                stop = before[stop]
            return path[::-1]
        for neighbour in lines.get(stop, ()):
            if neighbour not in before:
                before[neighbour] = stop
                queue.append(neighbour)
    return None


if __name__ == "__main__":
    trams = {"Market": ["Castle", "Harbour"], "Castle": ["University"], "Harbour": ["University"]}
    print(" -> ".join(route(trams, "Market", "University")))
)";

const char* const sensorData = R"({
  "station": "Balcony",
  "unit": "°C",
  "readings": [
    { "time": "06:00", "value": 11.4 },
    { "time": "09:00", "value": 15.9 },
    { "time": "12:00", "value": 21.2 },
    { "time": "15:00", "value": 23.8 },
    { "time": "18:00", "value": 20.1 }
  ]
}
)";

const char* const htmlPage = R"(<!DOCTYPE html>
<html lang="en">
<head><meta charset="utf-8"><title>Mira's garden</title></head>
<body>
  <h1>Balcony garden</h1>
  <p>Three tomatoes, one brave basil and far too much mint.</p>
</body>
</html>
)";

const char* const birthdayList = R"(# Birthdays 🎂

- 12 January – Dad 👨‍🌾
- 3 March – Aylin 🎸
- 28 April – grandma 🌷
- 9 August – Jonas 🧗
- 1 December – Noor ❄️
)";

const char* const arabicLetter = R"(جدتي العزيزة،

شكراً على الرسالة وعلى صور الحديقة الجميلة. الجامعة بخير، وقد انتهيت من الفصل الثالث من الرسالة.
سأزوركم في نهاية الشهر إن شاء الله، وسأحضر معي كعكة الليمون.

مع حبي،
ميرا
)";

const char* const arabicDates = R"(مواعيد العائلة

السبت: زيارة جدتي
الأحد: غداء مع نور
الثلاثاء: موعد الطبيب الساعة 10:30
)";

const char* const hebrewNotes = R"(רשימת קניות

- לחם
- עגבניות
- שמן זית
- קפה
)";

const char* const japaneseNotes = R"(旅行メモ

京都:三日間、東山の宿
奈良:日帰り
お土産:お茶、和菓子
)";

const char* const flatBudget = R"(Month,Rent,Electricity,Internet,Groceries,Paid by
January,820.00,61.40,29.90,212.35,Mira
February,820.00,58.75,29.90,198.10,Aylin
March,820.00,52.20,29.90,231.80,Jonas
April,820.00,44.95,29.90,205.60,Mira
May,820.00,39.10,29.90,219.45,Aylin
)";

const char* const climbingPlan = R"(# Climbing weekend

**Saturday** – meet at 7:30 at the station, platform 4. Easy routes on the north wall.
**Sunday** – the long ridge, if the weather holds; otherwise the hall.

| Who | Brings |
| --- | --- |
| Jonas | ropes, first-aid kit |
| Mira | food |
| Noor | car, maps |
)";

const char* const readingNotes = R"(# Reading notes

- *The Dispossessed* – walls, and who builds them. Chapter 9 again.
- *Momo* – for Aylin's birthday?
- Paper on dynamic shortest paths: compare with section 3.
)";

const char* const tripItinerary = R"(# Tuscany in six days

1. **Berlin → Florence** by night train
2. Florence: the market, San Miniato at sunset
3. Bus to Siena
4. Walk along the white roads
5. Hot springs
6. Home, with cheese
)";

const char* const diary = R"(# Travel diary

## Day 1

The night train was late and nobody minded. Mountains at six in the morning, coffee at seven.

![Arrival](assets/arrival.jpg)

## Day 2

We counted swallows until it was too dark to see them.
)";

std::string lecture(int number)
{
    static constexpr const char* topics[] = {"Vectors", "Linear maps", "Matrices", "Determinants",
        "Eigenvalues", "Inner products", "Orthogonality", "Singular values"};
    return std::string("# Lecture ") + std::to_string(number) + " – " + topics[(number - 1) % 8]
        + "\n\n- definition and first examples\n- the theorem of the day, with proof\n- exercises "
        + std::to_string(number * 3 - 2) + " to " + std::to_string(number * 3) + " for next week\n";
}

std::string receipt(int number)
{
    static constexpr const char* goods[] = {
        "Bread", "Apples", "Coffee", "Notebook", "Stamps", "Tea", "Soap", "Tram ticket"};
    const int first = number % 8, second = (number * 3 + 1) % 8;
    const auto price = [](int cents) {
        const auto fraction = std::to_string(cents % 100);
        return std::to_string(cents / 100) + '.' + (fraction.size() < 2 ? "0" : "") + fraction;
    };
    const int a = 120 + number * 37 % 480, b = 90 + number * 53 % 700;
    return "Receipt " + std::to_string(number) + "\n\n" + goods[first] + "  " + price(a) + "\n"
        + goods[second] + "  " + price(b) + "\n--------------\nTotal  " + price(a + b) + "\n";
}

} // namespace host::drive::sample::texts
