#include "store/StoreSchema.h"

namespace pallax {

// Comments before a statement are not kept in the file, those within it are.
const char* storeSchema() {
    return R"(
CREATE TABLE recordings (
    -- A recording is known by its packets, wherever its file is and however it is compressed.
    id INTEGER PRIMARY KEY,
    device TEXT NOT NULL,
    name TEXT NOT NULL,       -- of the file, without its folder
    digest TEXT NOT NULL UNIQUE, -- SHA-256 of the packets with their times
    beginnings TEXT NOT NULL, -- digests of its first 1, 2, 4, 8, ... packets: " 4:0f3a..."
    technology TEXT NOT NULL,
    decoder TEXT NOT NULL,    -- the version that read it: a newer one replaces all of its rows
    every TEXT NOT NULL,      -- tick: values at display ticks; packet: every value that was read
    identities TEXT NOT NULL, -- left out, or which key made their pseudonyms
    packets INTEGER NOT NULL,
    first INTEGER NOT NULL,   -- times are milliseconds since 1970, in UTC
    last INTEGER NOT NULL,
    trouble TEXT              -- why the end is missing
);
CREATE INDEX recordings_of_device ON recordings (device, first);
CREATE INDEX recordings_by_time ON recordings (first);

CREATE TABLE fields (
    -- All fields of the technologies that were loaded, as in pallax fields.
    id INTEGER PRIMARY KEY,
    name TEXT NOT NULL UNIQUE,
    path TEXT, kind TEXT, unit TEXT, least REAL, most REAL,
    in_list INTEGER, identifies INTEGER, personal INTEGER, meaning TEXT, shown INTEGER
);

CREATE TABLE texts (
    -- What is shown for a value that is not merely a number in its field's format.
    id INTEGER PRIMARY KEY,
    text TEXT NOT NULL,
    raw INTEGER, -- the number of a label in the record
    reason TEXT  -- why there is no value: not applicable, out of range
);
CREATE INDEX texts_by_text ON texts (text);

CREATE TABLE sites (
    -- The cells that served some device at some time.
    id INTEGER PRIMARY KEY,
    system TEXT NOT NULL,
    identity TEXT NOT NULL,
    code, channel,
    UNIQUE (system, identity)
);

CREATE TABLE series (
    -- The intervals of a field and entry in one serving cell, in a recording or in a part of a long
    -- one. They are in the rows from first_row to last_row in the order of their times, so that an
    -- interval need not say to what it belongs, new rows only ever come at the end, a recording is
    -- removed by ranges, and cells are compared without sorting.
    id INTEGER PRIMARY KEY,
    recording INTEGER NOT NULL REFERENCES recordings,
    field INTEGER NOT NULL REFERENCES fields,
    entry TEXT,
    site INTEGER REFERENCES sites, -- the serving cell; NULL: not known yet
    step,        -- whole numbers of intervals count steps of this size
    format TEXT, -- of numbers
    first_row INTEGER NOT NULL,
    last_row INTEGER NOT NULL,
    first INTEGER NOT NULL, -- the time of the first interval, since the recording's first packet
    last INTEGER NOT NULL   -- the end of the last
);
CREATE INDEX series_of_field ON series (field, recording);
CREATE INDEX series_of_recording ON series (recording);
CREATE INDEX series_of_site ON series (site, field);

CREATE TABLE intervals (
    -- A value for as long as it held: most numbers take two bytes.
    id INTEGER PRIMARY KEY,
    time INTEGER NOT NULL, -- milliseconds since the recording's first packet
    hold INTEGER NOT NULL, -- milliseconds
    number,                -- in steps if it is whole; NULL: a text, or no value
    text INTEGER,          -- NULL: the number in the format of the series
    packet INTEGER NOT NULL,
    whole INTEGER          -- where cells divide the time of a value: all of its milliseconds in the
                           -- first part, -1 in the others
);

CREATE TABLE totals (
    -- Of fields that profiles judge, how long each number held in a serving cell: a cell is judged
    -- by some hundred rows for each recording instead of thousands of intervals.
    field INTEGER NOT NULL REFERENCES fields,
    site INTEGER NOT NULL, -- 0: not known yet
    recording INTEGER NOT NULL REFERENCES recordings,
    number NOT NULL,
    hold INTEGER NOT NULL, -- milliseconds
    first INTEGER NOT NULL, -- when it held first, since the recording's first packet
    PRIMARY KEY (field, site, recording, number)
) WITHOUT ROWID;

CREATE TABLE events (
    recording INTEGER NOT NULL REFERENCES recordings,
    time INTEGER NOT NULL, -- microseconds since 1970, as in pallax sql
    packet INTEGER, kind TEXT, words TEXT, fields TEXT
);
CREATE INDEX events_of_recording ON events (recording);

CREATE TABLE cells (
    recording INTEGER NOT NULL REFERENCES recordings,
    role TEXT, system TEXT, identity TEXT, code, channel, first_time INTEGER, last_time INTEGER,
    packet INTEGER, readings INTEGER, measure TEXT, best_level REAL, last_level REAL
);
CREATE INDEX cells_of_recording ON cells (recording);

CREATE VIEW field AS
    SELECT name, path, kind, unit, least, most, in_list, identifies, personal, meaning, shown
    FROM fields;

CREATE VIEW event AS
    SELECT time, packet, kind, words, fields, device, r.name AS recording
    FROM recordings r JOIN events e ON e.recording = r.id;

CREATE VIEW cell AS
    SELECT role, system, identity, code, channel, first_time, last_time, packet, readings, measure,
        best_level, last_level, device, r.name AS recording
    FROM recordings r JOIN cells c ON c.recording = r.id;

CREATE VIEW measurement AS
    -- A row for each interval; start and hold are microseconds, as in pallax sql.
    SELECT (r.first + i.time) * 1000 AS start, i.hold * 1000 AS hold, f.name AS field, s.entry,
        CASE typeof(i.number) WHEN 'integer' THEN i.number * s.step ELSE i.number END AS number,
        CASE WHEN i.text IS NULL
            THEN format(s.format, CASE typeof(i.number)
                WHEN 'integer' THEN i.number * s.step ELSE i.number END)
            ELSE t.text END AS text,
        t.raw, t.reason, f.unit, p.system, p.identity AS cell, i.packet, r.device,
        r.name AS recording, r.technology, r.decoder
    FROM fields f CROSS JOIN series s ON s.field = f.id
        CROSS JOIN recordings r ON r.id = s.recording
        CROSS JOIN intervals i ON i.id BETWEEN s.first_row AND s.last_row
        LEFT JOIN texts t ON t.id = i.text
        LEFT JOIN sites p ON p.id = s.site;

CREATE VIEW span AS
    -- As in pallax sql: the time of a value is whole, whichever cells it was in.
    SELECT (r.first + i.time) * 1000 AS start, i.packet, f.name AS field, s.entry,
        coalesce(i.whole, i.hold) * 1000 AS hold,
        CASE typeof(i.number) WHEN 'integer' THEN i.number * s.step ELSE i.number END AS number,
        CASE WHEN i.text IS NULL
            THEN format(s.format, CASE typeof(i.number)
                WHEN 'integer' THEN i.number * s.step ELSE i.number END)
            ELSE t.text END AS text,
        f.unit, r.device, r.name AS recording
    FROM fields f CROSS JOIN series s ON s.field = f.id
        CROSS JOIN recordings r ON r.id = s.recording
        CROSS JOIN intervals i ON i.id BETWEEN s.first_row AND s.last_row
        LEFT JOIN texts t ON t.id = i.text
    WHERE coalesce(i.whole, 0) >= 0;
)";
}

} // namespace pallax
