-- cvxlatorluautils: helpers of the translator scripts.
--
-- The natively implemented helpers (mbsToUtf8, expandPath, searchQMErrors,
-- searchSharedErrors, mapErrorCode, unmapErrorCode) are added to this table
-- by the environment setup before any translator runs.

local M = {}

-- Loads a term table module; nil when it is absent, fails to load or is not
-- in UTF-8. Answers are cached per interpreter.
local cache = {}
function M.loadTable(name)
  local cached = cache[name]
  if cached ~= nil then return cached or nil end
  local ok, module = pcall(require, name)
  if ok and type(module) == "table" and module.encoding == "utf-8" then
    cache[name] = module
    return module
  end
  cache[name] = false
  return nil
end

-- The first line of a text.
function M.firstLine(text)
  return (string.match(text, "^[^\n]*"))
end

return M
