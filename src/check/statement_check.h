#pragma once

#include "check/tag_contents.h"

namespace zebtell::check {

// Tags whose contents name tables and columns otherwise than by a field reference.

void CheckQuery(PageReading& reading, const TagText& tag);          // ZEB:Query
void CheckQueryName(PageReading& reading, const TagText& tag);      // ZEB:Query.Reset and so on
void CheckCombo(PageReading& reading, const TagText& tag);          // ZEB:CreateCombo
void CheckPriceQuery(PageReading& reading, const TagText& tag);     // ZEB:PriceQuery
void CheckOrdersField(PageReading& reading, const TagText& tag);    // ZEB:Orders.Enable
void CheckFilter(PageReading& reading, const TagText& tag);         // ZEB:Filter
void CheckOrder(PageReading& reading, const TagText& tag);          // ZEB:Order of the catalogue
void CheckFavorites(PageReading& reading, const TagText& tag);      // ZEB:Favorites
void CheckArticleColumn(PageReading& reading, const TagText& tag);  // ZEB:Otsi.*
void CheckRowField(PageReading& reading, const TagText& tag);       // ZEB:EditField.*

// Whether the page defines the query.
bool DefinesQuery(const PageReading& reading, std::string_view name);

}  // namespace zebtell::check
