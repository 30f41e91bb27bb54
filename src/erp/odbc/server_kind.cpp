#include "erp/odbc/server_kind.h"

namespace zebtell::erp::odbc {

const ServerKind& SqlServer() {
    static const ServerKind kKind{
        .dialect = Dialect::kSqlServer,
        // An error ends the whole transaction. The settings from ANSI_NULLS on are those that
        // indexed views and computed columns of the ERP ask of everybody who writes.
        .set_up =
            "SET NOCOUNT ON; SET XACT_ABORT ON; SET LOCK_TIMEOUT 5000; "
            "SET ANSI_NULLS, ANSI_PADDING, ANSI_WARNINGS, ARITHABORT, "
            "CONCAT_NULL_YIELDS_NULL, QUOTED_IDENTIFIER ON; SET NUMERIC_ROUNDABORT OFF",
        .set_up_read = "",
        // What a save has read stays true until it is committed.
        .set_up_write = "SET TRANSACTION ISOLATION LEVEL SERIALIZABLE",
        .begin = "BEGIN TRANSACTION",
        .commit = "COMMIT TRANSACTION",
        .rollback = "IF @@TRANCOUNT > 0 ROLLBACK TRANSACTION",
        // Not OUTPUT, which tables with triggers refuse; not @@IDENTITY, which triggers change. In
        // the insert's own batch, since a prepared statement is a scope of its own.
        .insert_suffix = "; SELECT CAST(SCOPE_IDENTITY() AS bigint)",
        .last_key = "",
        .loose_types = false};
    return kKind;
}

}  // namespace zebtell::erp::odbc
