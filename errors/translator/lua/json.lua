-- json: a pure-script JSON reader (and a small writer) for the translator.
--
-- Unlike a reader that turns every number into a double, integer literals
-- that a double cannot hold exactly (beyond 2^53) are read as "stdint"
-- values, so 64-bit values in a description are shown exactly. JSON null
-- reads as json.null. Nesting deeper than 200 levels is refused, so hostile
-- input cannot exhaust the interpreter's stack.

local stdint = require "stdint"

local M = {}

M.null = setmetatable({}, { __tostring = function() return "null" end })

local maxDepth = 200
local byte, sub, find, char = string.byte, string.sub, string.find, string.char

local function fail(text, pos, what)
  error(string.format("json: %s at character %d", what, pos), 0)
end

local function skip(text, pos)
  local _, last = find(text, "^[ \t\r\n]*", pos)
  return last + 1
end

local function utf8(code)
  if code < 0x80 then return char(code) end
  if code < 0x800 then return char(0xC0 + math.floor(code / 0x40), 0x80 + code % 0x40) end
  if code < 0x10000 then
    return char(0xE0 + math.floor(code / 0x1000), 0x80 + math.floor(code / 0x40) % 0x40, 0x80 + code % 0x40)
  end
  return char(0xF0 + math.floor(code / 0x40000), 0x80 + math.floor(code / 0x1000) % 0x40,
    0x80 + math.floor(code / 0x40) % 0x40, 0x80 + code % 0x40)
end

local escapes = { ['"'] = '"', ["\\"] = "\\", ["/"] = "/", b = "\b", f = "\f", n = "\n", r = "\r", t = "\t" }

local function readString(text, pos)
  local parts = {}
  local i = pos + 1
  while true do
    local stop = find(text, '["\\]', i)
    if not stop then fail(text, pos, "unterminated string") end
    parts[#parts + 1] = sub(text, i, stop - 1)
    if byte(text, stop) == 34 then return table.concat(parts), stop + 1 end
    local e = sub(text, stop + 1, stop + 1)
    if e == "u" then
      local hex = sub(text, stop + 2, stop + 5)
      if not find(hex, "^%x%x%x%x$") then fail(text, stop, "bad unicode escape") end
      local code = tonumber(hex, 16)
      i = stop + 6
      if code >= 0xD800 and code <= 0xDBFF and sub(text, i, i + 1) == "\\u" then
        local low = tonumber(sub(text, i + 2, i + 5), 16)
        if low and low >= 0xDC00 and low <= 0xDFFF then
          code = 0x10000 + (code - 0xD800) * 0x400 + (low - 0xDC00)
          i = i + 6
        end
      end
      parts[#parts + 1] = utf8(code)
    elseif escapes[e] then
      parts[#parts + 1] = escapes[e]
      i = stop + 2
    else
      fail(text, stop, "bad escape")
    end
  end
end

local function readNumber(text, pos)
  local _, last = find(text, "^-?%d+%.?%d*[eE]?[-+]?%d*", pos)
  if not last then fail(text, pos, "bad number") end
  local literal = sub(text, pos, last)
  local value = tonumber(literal)
  if not value then fail(text, pos, "bad number") end
  if find(literal, "^-?%d+$") and #literal > 15 and math.abs(value) >= 9007199254740992 then
    local ok, exact = pcall(stdint.int64, literal)
    if ok and sub(literal, 1, 1) ~= "-" and exact < stdint.int64(0) then
      ok, exact = pcall(stdint.uint64, literal)
    end
    if ok then value = exact end
  end
  return value, last + 1
end

local readValue

local function readArray(text, pos, depth)
  local out = {}
  pos = skip(text, pos + 1)
  if byte(text, pos) == 93 then return out, pos + 1 end
  while true do
    out[#out + 1], pos = readValue(text, pos, depth)
    pos = skip(text, pos)
    local c = byte(text, pos)
    if c == 93 then return out, pos + 1 end
    if c ~= 44 then fail(text, pos, "expected ',' or ']'") end
    pos = skip(text, pos + 1)
  end
end

local function readObject(text, pos, depth)
  local out = {}
  pos = skip(text, pos + 1)
  if byte(text, pos) == 125 then return out, pos + 1 end
  while true do
    if byte(text, pos) ~= 34 then fail(text, pos, "expected a member name") end
    local key
    key, pos = readString(text, pos)
    pos = skip(text, pos)
    if byte(text, pos) ~= 58 then fail(text, pos, "expected ':'") end
    out[key], pos = readValue(text, skip(text, pos + 1), depth)
    pos = skip(text, pos)
    local c = byte(text, pos)
    if c == 125 then return out, pos + 1 end
    if c ~= 44 then fail(text, pos, "expected ',' or '}'") end
    pos = skip(text, pos + 1)
  end
end

readValue = function(text, pos, depth)
  if depth > maxDepth then fail(text, pos, "nesting too deep") end
  local c = byte(text, pos)
  if c == 123 then return readObject(text, pos, depth + 1) end
  if c == 91 then return readArray(text, pos, depth + 1) end
  if c == 34 then return readString(text, pos) end
  if c == 45 or (c and c >= 48 and c <= 57) then return readNumber(text, pos) end
  if sub(text, pos, pos + 3) == "true" then return true, pos + 4 end
  if sub(text, pos, pos + 4) == "false" then return false, pos + 5 end
  if sub(text, pos, pos + 3) == "null" then return M.null, pos + 4 end
  fail(text, pos, "unexpected character")
end

-- The value of JSON text `text`; raises an error for malformed text.
function M.decode(text)
  if type(text) ~= "string" then error("json: text expected", 0) end
  local value, pos = readValue(text, skip(text, 1), 0)
  pos = skip(text, pos)
  if pos <= #text then fail(text, pos, "trailing characters") end
  return value
end

local function quote(s)
  s = string.gsub(s, '[%c"\\]', function(c)
    local named = { ['"'] = '\\"', ["\\"] = "\\\\", ["\n"] = "\\n", ["\r"] = "\\r", ["\t"] = "\\t" }
    return named[c] or string.format("\\u%04x", byte(c))
  end)
  return '"' .. s .. '"'
end

local function isArray(t)
  local n = 0
  for _ in pairs(t) do n = n + 1 end
  return n == #t and (n > 0 or getmetatable(t) == M.arrayMarker)
end

M.arrayMarker = {}

-- An empty table that encodes as [].
function M.emptyArray()
  return setmetatable({}, M.arrayMarker)
end

-- JSON text of a value made of tables, strings, numbers, booleans, json.null
-- and stdint values. Object members are written in key order.
function M.encode(value, depth)
  depth = depth or 0
  if depth > maxDepth then error("json: nesting too deep", 0) end
  local kind = type(value)
  if value == M.null or value == nil then return "null" end
  if kind == "string" then return quote(value) end
  if kind == "boolean" then return tostring(value) end
  if kind == "number" then
    if value ~= value or value == math.huge or value == -math.huge then return "null" end
    if value == math.floor(value) and math.abs(value) < 2 ^ 63 then return string.format("%d", value) end
    return string.format("%.17g", value)
  end
  if stdint.isinteger(value) then return tostring(value) end
  if kind == "table" then
    local parts = {}
    if isArray(value) then
      for i = 1, #value do parts[i] = M.encode(value[i], depth + 1) end
      return "[" .. table.concat(parts, ",") .. "]"
    end
    local keys = {}
    for k in pairs(value) do keys[#keys + 1] = tostring(k) end
    table.sort(keys)
    for i, k in ipairs(keys) do
      local v = value[k]
      if v == nil then v = value[tonumber(k)] end
      parts[i] = quote(k) .. ":" .. M.encode(v, depth + 1)
    end
    return "{" .. table.concat(parts, ",") .. "}"
  end
  return quote(tostring(value))
end

return M
