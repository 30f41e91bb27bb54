-- One kind of request over all sessions in turn: `wrk ... -s pages.lua -- KIND`. More sessions than
-- connections, so that a session has one request at a time.
package.path = os.getenv("LOAD_FOLDER") .. "/?.lua;" .. package.path
local sessions = require("sessions")

setup = sessions.number_threads

local kinds = {
    -- the page that the session is on, shown again
    same = function(cookie) return sessions.get("Kaubainfo", cookie) end,
    -- from page to page through the list
    turn = function(cookie)
        return sessions.get("Kaubainfo&event=Navigate&Nav=NextPage", cookie)
    end,
    search = function(cookie, round)
        local words = {"polt", "M8", "tihend+10", "kinnas", "lamp*12", "3-0", "kaabel"}
        local body = "ZEBInText=" .. words[round % #words + 1] ..
                         "&Combo_GRArticleCat=0&Find_GRArticle=Otsi"
        return sessions.post("Kaubainfo&event=Hinnakiri", cookie, body)
    end,
    -- searches for something that nobody has searched for before
    newsearch = function(cookie, round)
        local body = "ZEBInText=" .. string.format("%x", thread_number * 7 + round * 31) ..
                         "&Combo_GRArticleCat=0&Find_GRArticle=Otsi"
        return sessions.post("Kaubainfo&event=Hinnakiri", cookie, body)
    end,
    static = function() return wrk.format("GET", "/page.html") end,
}

local kind, cookies
local round = 0
failures = 0

function init(args)
    kind = assert(kinds[args[1]], "no such kind of request")
    cookies = sessions.mine(thread_number, tonumber(os.getenv("WRK_THREADS")))
end

function request()
    round = round + 1
    return kind(cookies[round % #cookies + 1], round)
end

function done(summary, latency)
    local seconds = summary.duration / 1e6
    io.write(string.format("RESULT %.0f %.0f %.0f %d %d\n", summary.requests / seconds,
                           latency:percentile(50), latency:percentile(99),
                           summary.requests, summary.bytes / summary.requests))
    if summary.errors.status > 0 or summary.errors.read > 0 or summary.errors.timeout > 0 then
        io.write("FAILED ", summary.errors.status, " answers and ",
                 summary.errors.read + summary.errors.timeout, " connections\n")
    end
end
