#include "erp/order_image.h"

namespace zebtell::erp {
namespace {

std::shared_ptr<const RowSet> ReadRows(const Translator& translator,
                                       const Reader& reader,
                                       Connection& connection,
                                       const char* table,
                                       std::span<const std::int64_t> ids) {
    std::vector<std::string> columns = translator.ReadableColumns(reader, table);
    std::erase_if(columns, [](const auto& name) { return base::EqualNoCase(name, "ID"); });
    const auto cursor = connection.Query(translator.RowsByID(reader, table, ids, columns));
    columns.insert(columns.begin(), "ID");
    RowSet rows(std::make_shared<const FieldSet>(std::move(columns)));
    while (cursor->Next()) {
        rows.Append(*cursor);
    }
    return RowSet::Arranged(rows, ids);
}

std::vector<std::int64_t> ReadRowIds(const Translator& translator,
                                     const Reader& reader,
                                     Connection& connection,
                                     std::int64_t id) {
    const std::string filter = std::string(kOrderRowLink) + "=" + std::to_string(id);
    const auto cursor =
        connection.Query(translator.ListKeys(reader, kOrderRowTable, filter, "RowNo", {}));
    std::vector<std::int64_t> ids;
    while (cursor->Next()) {
        ids.push_back(cursor->GetInteger(0));
    }
    return ids;
}

}  // namespace

std::optional<OrderImage> ReadOrderImage(const Translator& translator,
                                         const Reader& reader,
                                         Connection& connection,
                                         std::int64_t id) {
    OrderImage image;
    image.header = ReadRows(translator, reader, connection, kOrderTable, std::span(&id, 1));
    if (!image.header->Has(0)) {
        return std::nullopt;
    }
    image.row_ids = ReadRowIds(translator, reader, connection, id);
    image.rows = ReadRows(translator, reader, connection, kOrderRowTable, image.row_ids);
    return image;
}

bool IsSame(const OrderImage& a, const OrderImage& b) {
    return a.row_ids == b.row_ids && a.header->HasSameValues(*b.header) &&
           a.rows->HasSameValues(*b.rows);
}

}  // namespace zebtell::erp
