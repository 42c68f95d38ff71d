-- One headless session of the host's Lua session runner, in two runs.
--
-- ROUTE_MODE=create: a new session on the dummy audio backend, a stereo track
-- with the plug-in inserted, a factory program selected and one parameter set;
-- the backend's signal generator is recorded onto the track (the take is the
-- input the command-line host renders later), the master bus is exported over
-- the take and the session is saved.
-- ROUTE_MODE=reload: the saved session is loaded, the plug-in and its
-- parameter value are looked up and the take is exported again.
--
-- Every value comes from the environment (see run_session_route.sh). Lines
-- starting "ROUTE " are for the driving script; "ROUTE done" closes a run that
-- did everything it was asked to do.
local mode = os.getenv("ROUTE_MODE")
local dir = os.getenv("ROUTE_SESSION_DIR")
local name = os.getenv("ROUTE_SESSION_NAME")
local export_dir = os.getenv("ROUTE_EXPORT_DIR")
local export_preset = os.getenv("ROUTE_EXPORT_PRESET")
local plugin_id = os.getenv("ROUTE_PLUGIN_ID")
local program = tonumber(os.getenv("ROUTE_PROGRAM"))
local param = tonumber(os.getenv("ROUTE_PARAM_INDEX"))
local value = tonumber(os.getenv("ROUTE_PARAM_VALUE"))

local function fail(text)
  print("ROUTE FAIL " .. text)
  close_session()
  quit()
end

local function find_insert(track)
  local i = 0
  while true do
    local proc = track:nth_plugin(i)
    if proc:isnil() then return nil end
    local insert = proc:to_insert()
    if not insert:isnil() and insert:plugin(0):unique_id() == plugin_id then return insert end
    i = i + 1
  end
end

local function take_length(track)
  local regions = 0
  local length = 0
  for region in track:playlist():region_list():iter() do
    regions = regions + 1
    length = region:length():samples()
    if region:position():samples() ~= 0 then fail("the take does not start at 0") end
    for c = 0, 1 do  -- the stereo track records one file per channel
      local source = region:source(c)
      if source:isnil() then fail("the take has no channel " .. c) end
      print("ROUTE take " .. c .. " " .. source:to_filesource():path())
    end
  end
  if regions ~= 1 then fail(regions .. " regions on the track, expected 1") end
  return length
end

local function export_master(length, label)
  local export = Session:simple_export()
  if not export:set_preset(export_preset) then fail("export preset " .. export_preset .. " unknown") end
  export:set_folder(export_dir)
  export:set_name(label)
  export:set_range(0, length)
  if not export:check_outputs() then fail("nothing to export") end
  if not export:run_export() then fail("export " .. label) end
  print("ROUTE exported " .. label .. " " .. length)
  -- The exporter goes while the session is still open, not whenever the
  -- garbage collector gets to it.
  export = nil
  collectgarbage("collect")
end

AudioEngine:set_backend("None (Dummy)", "", "")

if mode == "create" then
  -- The dummy backend's capture ports carry a generated sweep.
  AudioEngine:set_device_name("Sine Sweep")
  if not create_session(dir, name, 48000) then fail("create_session") end
  local tracks = Session:new_audio_track(2, 2, nil, 1, "Drive", ARDOUR.PresentationInfo.max_order,
                                         ARDOUR.TrackMode.Normal, true)
  if tracks:size() ~= 1 then fail("new_audio_track") end
  local track = tracks:front()
  local plugin = ARDOUR.LuaAPI.new_plugin(Session, plugin_id, ARDOUR.PluginType.LXVST, "")
  if plugin:isnil() then fail("new_plugin found no plug-in " .. plugin_id) end
  if track:add_processor_by_index(plugin, 0, nil, true) ~= 0 then fail("add_processor_by_index") end
  local insert = plugin:to_insert()
  local vst = insert:plugin(0)
  print("ROUTE inserted " .. vst:name())

  -- The host offers the plug-in's own programs as presets "VST:<id>:<index>".
  local uri = string.format("VST:%s:%04d", plugin_id, program)
  local preset = vst:preset_by_uri(uri)
  if preset == nil or not preset.valid then fail("no preset " .. uri) end
  if not vst:load_preset(preset) then fail("load_preset " .. uri) end
  print("ROUTE program " .. program .. " " .. preset.label)
  ARDOUR.LuaAPI.set_plugin_insert_param(insert, param, value)
  print(string.format("ROUTE param %d %.6f", param, ARDOUR.LuaAPI.get_plugin_insert_param(insert, param, true)))

  local record_us = math.floor(tonumber(os.getenv("ROUTE_RECORD_SECONDS")) * 1000000)
  track:rec_enable_control():set_value(1, PBD.GroupControlDisposition.NoGroup)
  Session:maybe_enable_record(false)
  Session:request_roll(ARDOUR.TransportRequestSource.TRS_UI)
  ARDOUR.LuaAPI.usleep(record_us)
  Session:request_stop(false, false, ARDOUR.TransportRequestSource.TRS_UI)
  ARDOUR.LuaAPI.usleep(300000)
  track:rec_enable_control():set_value(0, PBD.GroupControlDisposition.NoGroup)
  Session:disable_record(false, false)
  local length = take_length(track)
  -- A region fades in and out over a few milliseconds; the render it is
  -- compared with plays the take as recorded, so this session uses no fades.
  Session:cfg():set_use_region_fades(false)

  export_master(length, "first")
  if Session:save_state("", false, false, false, false, false) ~= 0 then fail("save_state") end
  print("ROUTE saved")
else
  if not load_session(dir, name) then fail("load_session") end
  local route = Session:route_by_name("Drive")
  if route:isnil() then fail("the track is gone after reload") end
  local track = route:to_track()
  local insert = find_insert(track)
  if insert == nil then fail("the plug-in is gone after reload") end
  print(string.format("ROUTE param %d %.6f", param, ARDOUR.LuaAPI.get_plugin_insert_param(insert, param, true)))
  export_master(take_length(track), "second")
end
print("ROUTE done")
close_session()
quit()
