-- The tables of a store of measurements in ClickHouse. `pallax store setup` runs these statements on
-- one server; docs/fleet.md tells how to set up several. Run as they are, they make a store on one
-- server. For the servers of a cluster, setup changes three things:
--
--   MergeTree() becomes ReplicatedMergeTree(...) if the cluster has replicas.
--   CREATE VIEW x AS SELECT * FROM x_local becomes a Distributed table over the shards' x_local.
--   The view `store`, which is made last and says that the store is complete, has the cluster's name.
--
-- All of it runs on version 18.16, which has no TTL, CODEC, DateTime64 or window functions. What
-- follows from that is said where it matters.
--
-- A recording lives on the shard of its device, with everything that it measured. So each shard
-- alone can tell which rows are current, and nothing is joined between servers.
--
-- Nothing is changed or deleted by loading: each load of a recording has a number, all of its rows
-- have it, and the last thing that a load writes is its row in loads_local. The views show the rows
-- of the latest load of each recording that is complete. A load that was broken off leaves rows that
-- nobody sees. No merge is needed for an answer to be right.

CREATE TABLE IF NOT EXISTS loads_local (
    load UInt64,       -- milliseconds since 1970 and 20 random bits; a later load has a greater number
    gone UInt8,        -- 1: the recording is no longer in the store
    device String,
    name String,       -- of the file, without its folder
    digest String,     -- SHA-256 of the packets with their times: what the recording is known by
    beginnings String, -- digests of its first 1, 2, 4, 8, ... packets: " 4:0f3a..."
    technology String,
    decoder String,    -- the version that read it
    every String,      -- tick: values at display ticks; packet: every value that was read
    identities String, -- left out, or which key made their pseudonyms
    packets Int64,
    first Int64,       -- times are milliseconds since 1970, in UTC
    last Int64,
    trouble String     -- why the end is missing; empty: it is not
) ENGINE = MergeTree() ORDER BY (digest, load);

-- A value for as long as it held, in one serving cell. What is the same in long runs of rows costs
-- almost nothing, so the names are there in full and no join is needed. What differs from row to row
-- is cut into columns of one or two bytes, most of which repeat: without CODEC, a day of a device so
-- takes little more than half the space.
--
-- Partitions are months of the recordings' beginnings, so that one recording is in one partition and
-- old months can be dropped as a whole. The order is by field first, because questions are about a
-- few fields of many devices; `load` is in it because ClickHouse then decides which loads are current
-- before it looks for parts: a query sees all rows of a load or none.
CREATE TABLE IF NOT EXISTS intervals_local (
    device String,
    load UInt64,
    month UInt32,        -- 202611
    field String,
    entry String,        -- empty: of no list
    system String,       -- of the serving cell; empty: not known yet
    cell String,
    day Int32,           -- since 1970
    minute UInt16,       -- of the day
    second UInt8,        -- of the minute
    ms UInt16,
    hold_minutes UInt32, -- how long it held: whole minutes,
    hold_seconds UInt8,  -- seconds
    hold_ms UInt16,      -- and milliseconds
    part UInt8,          -- 0: no cell divides the time of the value; 1: its first part; 2: another
    whole_minutes UInt32, whole_seconds UInt8, whole_ms UInt16, -- of all parts, in the first one
    known UInt8,         -- 1: it has a number: steps * step + rest
    steps Int16,
    step Float64,
    rest Float64,
    decimals Int8,       -- 0 or more: its text is the number with so many decimals and the suffix
    suffix String,
    text String,         -- otherwise
    raw Nullable(Int64), -- the number of a label in the record
    reason String,       -- why there is no value; empty: there is one
    unit String,
    packet_high UInt16, packet_middle UInt8, packet_low UInt8,
    recording String,
    technology String,
    decoder String
) ENGINE = MergeTree() PARTITION BY month
ORDER BY (field, device, load, system, cell, entry, day, minute, second, ms);

CREATE TABLE IF NOT EXISTS events_local (
    device String, load UInt64, month UInt32, recording String,
    time Int64, -- microseconds since 1970
    packet Int64, kind String, words String, fields String
) ENGINE = MergeTree() PARTITION BY month ORDER BY (device, load, time);

CREATE TABLE IF NOT EXISTS cells_local (
    device String, load UInt64, month UInt32, recording String,
    role String, system String, identity String,
    code Nullable(String), channel Nullable(String), -- numbers, or names of cells of other systems
    first_time Int64, last_time Int64, packet Int64, readings Int64,
    measure Nullable(String), best_level Nullable(Float64), last_level Nullable(Float64)
) ENGINE = MergeTree() PARTITION BY month ORDER BY (device, load, system, identity);

-- All fields of the technologies that were loaded, each on the shard of its name. A row is added when
-- a field is new or has changed.
CREATE TABLE IF NOT EXISTS fields_local (
    name String, path String, kind String, unit String,
    least Nullable(Float64), most Nullable(Float64),
    in_list UInt8, identifies UInt8, personal UInt8, meaning String, shown UInt8,
    load UInt64,   -- the latest counts
    content String -- a digest of the other columns
) ENGINE = MergeTree() ORDER BY (name, load);

-- Roll-ups to a minute and an hour, of the levels of what serves: they are a small part of the rows,
-- and what is asked about years. A value that holds for more than a day counts for its first day.
-- They are filled by whatever is inserted into intervals_local, and hidden with it.
CREATE TABLE IF NOT EXISTS minutes_local (
    field String, device String, load UInt64, month UInt32, system String, cell String,
    at_minute UInt32, -- since 1970
    held AggregateFunction(sum, Int64), weighted AggregateFunction(sum, Float64),
    lowest AggregateFunction(min, Float32), highest AggregateFunction(max, Float32)
) ENGINE = AggregatingMergeTree() PARTITION BY month
ORDER BY (field, device, load, system, cell, at_minute);

CREATE TABLE IF NOT EXISTS hours_local (
    field String, device String, load UInt64, month UInt32, system String, cell String,
    at_hour UInt32, -- since 1970
    held AggregateFunction(sum, Int64), weighted AggregateFunction(sum, Float64),
    lowest AggregateFunction(min, Float32), highest AggregateFunction(max, Float32)
) ENGINE = AggregatingMergeTree() PARTITION BY month
ORDER BY (field, device, load, system, cell, at_hour);

CREATE MATERIALIZED VIEW IF NOT EXISTS minutes_filled TO minutes_local AS
WITH (toInt64(day) * 1440 + minute) * 60000 + toInt64(second) * 1000 + ms AS since,
    since + toInt64(hold_minutes) * 60000 + toInt64(hold_seconds) * 1000 + hold_ms AS until,
    intDiv(since, 60000) + toInt64(arrayJoin(range(toUInt64(
        least(intDiv(until - 1, 60000) - intDiv(since, 60000) + 1, 1440))))) AS piece,
    least(until, piece * 60000 + 60000) - greatest(since, piece * 60000) AS part,
    steps * step + rest AS number
SELECT field, device, load, month, system, cell, toUInt32(piece) AS at_minute,
    sumState(part) AS held, sumState(number * part) AS weighted,
    minState(toFloat32(number)) AS lowest, maxState(toFloat32(number)) AS highest
FROM intervals_local
WHERE known = 1 AND hold_minutes + hold_seconds + hold_ms > 0 AND entry = '' AND unit IN ('dBm', 'dB')
GROUP BY field, device, load, month, system, cell, piece;

CREATE MATERIALIZED VIEW IF NOT EXISTS hours_filled TO hours_local AS
WITH (toInt64(day) * 1440 + minute) * 60000 + toInt64(second) * 1000 + ms AS since,
    since + toInt64(hold_minutes) * 60000 + toInt64(hold_seconds) * 1000 + hold_ms AS until,
    intDiv(since, 3600000) + toInt64(arrayJoin(range(toUInt64(
        least(intDiv(until - 1, 3600000) - intDiv(since, 3600000) + 1, 24))))) AS piece,
    least(until, piece * 3600000 + 3600000) - greatest(since, piece * 3600000) AS part,
    steps * step + rest AS number
SELECT field, device, load, month, system, cell, toUInt32(piece) AS at_hour,
    sumState(part) AS held, sumState(number * part) AS weighted,
    minState(toFloat32(number)) AS lowest, maxState(toFloat32(number)) AS highest
FROM intervals_local
WHERE known = 1 AND hold_minutes + hold_seconds + hold_ms > 0 AND entry = '' AND unit IN ('dBm', 'dB')
GROUP BY field, device, load, month, system, cell, piece;

-- The loads of this shard that count: the latest of each recording. One scan of one table, so a query
-- sees a recording before it is replaced or after, and never both or neither. Each query on
-- measurements begins with it, so it reads as little as possible.
CREATE VIEW IF NOT EXISTS current_local AS
SELECT latest AS load
FROM (SELECT max(load) AS latest, argMax(gone, load) AS is_gone FROM loads_local
    GROUP BY sipHash128(digest)) -- in half the time and memory of the text
WHERE is_gone = 0;

-- The recordings of this shard.
CREATE VIEW IF NOT EXISTS recordings_local AS
SELECT load, device, name, digest, beginnings, technology, decoder, every, identities, packets,
    first, last, nullIf(trouble, '') AS trouble
FROM (SELECT * FROM loads_local ORDER BY digest, load DESC LIMIT 1 BY digest)
WHERE gone = 0;

-- The current intervals with their times in milliseconds, numbers and texts.
CREATE VIEW IF NOT EXISTS values_local AS
SELECT (toInt64(day) * 1440 + minute) * 60000 + toInt64(second) * 1000 + ms AS since,
    toInt64(hold_minutes) * 60000 + toInt64(hold_seconds) * 1000 + hold_ms AS held, part,
    toInt64(whole_minutes) * 60000 + toInt64(whole_seconds) * 1000 + whole_ms AS whole, field, entry, system, cell,
    steps * step + rest AS value, if(known = 1, value, NULL) AS number,
    [1, 10, 100, 1000, 10000][greatest(decimals, 0) + 1] AS scale,
    toInt64(round(abs(value) * scale)) AS scaled,
    if(decimals < 0, text, concat(if(value < 0, '-', ''), toString(intDiv(scaled, scale)),
        if(decimals < 1, '', concat('.', substring(toString(scale + scaled % scale), 2))),
        suffix)) AS words,
    raw, reason, unit,
    toInt64(packet_high) * 65536 + toInt64(packet_middle) * 256 + packet_low AS packet,
    device, recording, technology, decoder
FROM intervals_local
WHERE load IN (SELECT load FROM current_local);

-- A row for each interval; start and hold are microseconds, as in pallax sql.
CREATE VIEW IF NOT EXISTS measurement_local AS
SELECT since * 1000 AS start, held * 1000 AS hold, field, nullIf(entry, '') AS entry, number,
    words AS text, raw, nullIf(reason, '') AS reason, unit, nullIf(system, '') AS system,
    nullIf(cell, '') AS cell, packet, device, recording, technology, decoder
FROM values_local;

-- As in pallax sql: the time of a value is whole, whichever cells it was in.
CREATE VIEW IF NOT EXISTS span_local AS
SELECT since * 1000 AS start, packet, field, nullIf(entry, '') AS entry,
    if(part = 1, whole, held) * 1000 AS hold, number, words AS text, unit, device, recording
FROM values_local
WHERE part < 2;

CREATE VIEW IF NOT EXISTS event_local AS
SELECT time, packet, kind, words, fields, device, recording
FROM events_local WHERE load IN (SELECT load FROM current_local);

CREATE VIEW IF NOT EXISTS cell_local AS
SELECT role, system, identity, code, channel, first_time, last_time, packet, readings, measure,
    best_level, last_level, device, recording
FROM cells_local WHERE load IN (SELECT load FROM current_local);

CREATE VIEW IF NOT EXISTS field_local AS
SELECT name, path, kind, unit, least, most, in_list, identifies, personal, meaning, shown
FROM (SELECT * FROM fields_local ORDER BY name, load DESC LIMIT 1 BY name);

-- Levels by the minute and by the hour; start and hold are microseconds.
CREATE VIEW IF NOT EXISTS level_by_minute_local AS
SELECT field, device, nullIf(system, '') AS system, nullIf(cell, '') AS cell,
    toInt64(at_minute) * 60000000 AS start, hold_sum * 1000 AS hold, least,
    weighted_sum / hold_sum AS mean, greatest
FROM (
    SELECT field, device, load, system, cell, at_minute, sumMerge(held) AS hold_sum,
        sumMerge(weighted) AS weighted_sum, minMerge(lowest) AS least, maxMerge(highest) AS greatest
    FROM minutes_local WHERE load IN (SELECT load FROM current_local)
    GROUP BY field, device, load, system, cell, at_minute
);

CREATE VIEW IF NOT EXISTS level_by_hour_local AS
SELECT field, device, nullIf(system, '') AS system, nullIf(cell, '') AS cell,
    toInt64(at_hour) * 3600000000 AS start, hold_sum * 1000 AS hold, least,
    weighted_sum / hold_sum AS mean, greatest
FROM (
    SELECT field, device, load, system, cell, at_hour, sumMerge(held) AS hold_sum,
        sumMerge(weighted) AS weighted_sum, minMerge(lowest) AS least, maxMerge(highest) AS greatest
    FROM hours_local WHERE load IN (SELECT load FROM current_local)
    GROUP BY field, device, load, system, cell, at_hour
);

-- What users ask. On one server they are the same as the above.
CREATE VIEW IF NOT EXISTS loads AS SELECT * FROM loads_local;
CREATE VIEW IF NOT EXISTS intervals AS SELECT * FROM intervals_local;
CREATE VIEW IF NOT EXISTS events AS SELECT * FROM events_local;
CREATE VIEW IF NOT EXISTS cells AS SELECT * FROM cells_local;
CREATE VIEW IF NOT EXISTS fields AS SELECT * FROM fields_local;
CREATE VIEW IF NOT EXISTS recordings AS SELECT * FROM recordings_local;
CREATE VIEW IF NOT EXISTS measurement AS SELECT * FROM measurement_local;
CREATE VIEW IF NOT EXISTS span AS SELECT * FROM span_local;
CREATE VIEW IF NOT EXISTS event AS SELECT * FROM event_local;
CREATE VIEW IF NOT EXISTS cell AS SELECT * FROM cell_local;
CREATE VIEW IF NOT EXISTS field AS SELECT * FROM field_local;
CREATE VIEW IF NOT EXISTS level_by_minute AS SELECT * FROM level_by_minute_local;
CREATE VIEW IF NOT EXISTS level_by_hour AS SELECT * FROM level_by_hour_local;

CREATE VIEW IF NOT EXISTS store AS SELECT toUInt32(1) AS version, '' AS cluster, toUInt32(1) AS copies;
