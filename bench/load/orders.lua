-- Whole orders: add two articles, change a quantity, go on, store, see the stored order. One
-- connection and one session a thread (`wrk -t16 -c16`), so that the steps follow one another.
package.path = os.getenv("LOAD_FOLDER") .. "/?.lua;" .. package.path
local sessions = require("sessions")
local ffi = require("ffi")
ffi.cdef [[
    typedef struct { long seconds; long nanoseconds; } load_time;
    int clock_gettime(int clock, load_time *time);
]]

local threads = {}
function setup(thread)
    sessions.number_threads(thread)
    table.insert(threads, thread)
end

local cookie, boxes
local step, began = 1, 0
local time = ffi.new("load_time")
stored, wrong, durations = 0, 0, ""

local function now()
    ffi.C.clock_gettime(1, time)
    return tonumber(time.seconds) * 1e6 + tonumber(time.nanoseconds) / 1e3
end

local kTell = "Kaubainfo&event=Tellimus"
local steps = {
    {
        function() return sessions.get("Kaubainfo", cookie) end,
        200, 'name="ID_',
    },
    {
        function()
            local body = boxes[1] .. "=2&" .. boxes[2] .. "=1,5"
            return sessions.post("Kaubainfo&event=Lisamine", cookie, body)
        end,
        303,
    },
    {
        function() return sessions.post(kTell, cookie, "Row_1=3&Row_2=1,5&Change_Quant=Muuda") end,
        303,
    },
    {
        function() return sessions.post(kTell, cookie, "Row_1=3&Row_2=1,5&Vormista=Vormista") end,
        303,
    },
    {function() return sessions.get("Kinnitus", cookie) end, 200, "ZEB_But_Vormista"},
    {
        function()
            return sessions.post("Kinnitus&event=LisaTellimus", cookie,
                                 "ZEB_But_Vormista=Vormista&ZEB_Komment=koormus")
        end,
        303,
    },
    {function() return sessions.get("Tellimus", cookie) end, 200},
}

function init()
    cookie = sessions.mine(thread_number, tonumber(os.getenv("WRK_THREADS")))[1]
end

-- The step goes on with the answer: wrk asks for a first request that it does not send.
function request()
    if step == 1 then began = now() end
    return steps[step][1]()
end

function response(status, _, body)
    local expected = steps[step]
    if status ~= expected[2] or (expected[3] and not body:find(expected[3], 1, true)) then
        wrong = wrong + 1
    end
    if step == 1 then
        boxes = {}
        for box in body:gmatch('name="(ID_%d+)"') do boxes[#boxes + 1] = box end
    elseif step == #steps then
        stored = stored + 1
        durations = durations .. string.format("%d ", now() - began)
    end
    step = step % #steps + 1
end

function done(summary)
    local all, orders, mistakes = {}, 0, 0
    for _, thread in ipairs(threads) do
        orders = orders + thread:get("stored")
        mistakes = mistakes + thread:get("wrong")
        for duration in thread:get("durations"):gmatch("%d+") do
            all[#all + 1] = tonumber(duration)
        end
    end
    table.sort(all)
    local function percentile(p) return all[math.max(1, math.ceil(#all * p / 100))] or 0 end
    io.write(string.format("RESULT %.1f %d %d %d 0\n", orders / (summary.duration / 1e6),
                           percentile(50), percentile(99), orders))
    if mistakes > 0 then io.write("FAILED ", mistakes, " answers\n") end
end
