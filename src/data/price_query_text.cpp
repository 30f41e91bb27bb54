#include "data/price_query_text.h"

namespace zebtell::data {

std::string DefaultPriceQueryText() {
    return "select s5.*, rc.idgrcompany, isnull(pricecut, 0) as pricecut,"
           "round (price * (100 + isnull(pricecut, 0)), 0) / 100 as finalprice\r\n"
           "from\r\n"
           "sqpricelist5 s5 with (nolock)\r\n"
           "left join (\r\n"
           "select\r\n"
           "rel.pricecut, rel.idgrpricelist, gc.id as idgrcompany, ga.id as idgrarticle\r\n"
           "from\r\n"
           "grpricecatrel rel with (nolock)\r\n"
           "inner join grarticle ga with (nolock)"
           " on ga.idgrarticlepricecat=rel.idgrarticlepricecat\r\n"
           "inner join grcompany gc with (nolock)"
           " on gc.idgrcompanypricecat=rel.idgrcompanypricecat\r\n"
           "where gc.id=#P\r\n"
           ") rc on s5.idgrarticle=rc.idgrarticle and s5.idsrcpricelist=rc.idgrpricelist\r\n"
           "where\r\n"
           "s5.idgrpricelist=#H\r\n"
           "and s5.idgrarticle in (#A)";
}

}  // namespace zebtell::data
