#include "erp/order_loading.h"

#include <sodium.h>

#include "erp/keyed_list.h"
#include "erp/order_image.h"

namespace zebtell::erp {
namespace {

std::string NewKey() {
    unsigned char bytes[16];
    randombytes_buf(bytes, sizeof bytes);
    char text[sizeof bytes * 2 + 1];
    sodium_bin2hex(text, sizeof text, bytes, sizeof bytes);
    return text;
}

std::string TextOf(data::Record& record, std::string_view field) {
    const base::Value value = record.GetField(field);
    return std::string(base::Trimmed(value.ToPlainText()));
}

// "Tamme 5, 10115 Tallinn"
std::string AddressOf(data::Record& company) {
    const std::string street = TextOf(company, "Address");
    const std::string town = TextOf(company, "PostCode") + " " + TextOf(company, "City");
    const std::string_view trimmed = base::Trimmed(town);
    return street + (street.empty() || trimmed.empty() ? "" : ", ") + std::string(trimmed);
}

void TakeCompany(Order& order) {
    const Reader& reader = order.session()->reader();
    const TableInfo& companies = order.session()->database().Table("GRCompany");
    const auto company =
        reader.partner == 0 ? nullptr : LoadRecord(order.session(), companies, reader.partner);
    if (company) {
        order.header.Set("IDGRCompany", reader.partner);
        order.header.Set("CompanyName", TextOf(*company, "Name"));
        order.header.Set("CompanyAddr", AddressOf(*company));
    }
}

std::string ReadKey(Connection& connection, std::int64_t id) {
    const auto row = connection.Query({"SELECT DocKey FROM GDocument WHERE ID = ?", {id}});
    return row->Next() ? row->Get(0).ToPlainText() : "";
}

std::shared_ptr<OrderRow> LoadedRow(const TableInfo& table,
                                    const OrderImage& image,
                                    std::size_t index) {
    auto row = std::make_shared<OrderRow>(table);
    row->id = image.row_ids[index];
    row->fields.Take(*image.rows, index);
    row->fields.Set("@unitprice", row->fields.Get("Price"));
    return row;
}

}  // namespace

std::shared_ptr<Order> NewOrder(const std::shared_ptr<Session>& session) {
    auto order = std::make_shared<Order>(session);
    order->key = NewKey();
    order->header.Set("DocDate", session->clock()().DateOnly());
    order->header.Set("State", 0);
    order->header.Set("NeedsReview", false);
    if (!session->reader().price_lists.empty()) {
        order->header.Set("IDGRPriceList", session->reader().price_lists.front());
    }
    TakeCompany(*order);
    return order;
}

std::shared_ptr<Order> LoadOrder(const std::shared_ptr<Session>& session, std::int64_t id) {
    auto order = std::make_shared<Order>(session);
    auto image = session->database().pool().Reading([&](Connection& connection) {
        order->key = ReadKey(connection, id);
        return ReadOrderImage(session->database().translator(), session->reader(), connection, id);
    });
    if (!image) {
        return nullptr;
    }
    order->id = id;
    order->header.Take(*image->header, 0);
    const TableInfo& table = session->database().Table(kOrderRowTable);
    for (std::size_t index = 0; index < image->row_ids.size(); ++index) {
        order->rows.push_back(LoadedRow(table, *image, index));
    }
    order->image = std::move(image);
    order->changed = false;
    return order;
}

std::int64_t FindOrder(Session& session, std::string_view key) {
    const BoundSql sql{
        "SELECT d.ID FROM GDocument d INNER JOIN SDOrder o ON o.ID = d.ID "
        "WHERE d.DocKey = ? AND o.IDGRCompany = ?",
        {std::string(key), session.reader().partner}};
    const auto id = session.database().pool().Reading([&sql](Connection& connection) {
        const auto row = connection.Query(sql);
        return row->Next() ? row->GetInteger(0) : 0;
    });
    if (id != 0) {
        session.AddSavedDocument(id);
    }
    return id;
}

}  // namespace zebtell::erp
