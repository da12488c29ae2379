// The floor as FloorGrid has it, for a renderer that reads textures on a processor: the share of each pixel that lines
// cover is computed.

// Of each edge of a tile, as a share of its side: two texels.
uniform float u_LineWidth;
// From a pixel to the next one across and the next one up: by how much tiles change, and 1, each divided by depth.
uniform vec4 u_TilesAcross;
uniform vec4 u_TilesUp;
uniform vec2 u_InverseDepths;

// In large tiles, and in small ones.
varying vec4 v_Tiles;
varying float v_CameraHeight;

void main()
{
	vec4 pixel = abs(u_TilesAcross - v_Tiles * u_InverseDepths.x) + abs(u_TilesUp - v_Tiles * u_InverseDepths.y);
	// At least half a texel to each side, where lines are seen from near.
	vec4 reach = max(0.5 * pixel / gl_FragCoord.w, 0.25 * u_LineWidth);
	// What it has in common with the nearest line. Where a pixel reaches more than one they are too faint to be seen.
	vec4 apart = 0.5 - abs(fract(v_Tiles) - 0.5);
	vec4 common = clamp(reach + u_LineWidth - apart, vec4(0.0), 2.0 * min(reach, vec4(u_LineWidth)));
	vec4 dark = reach - 0.5 * common;
	vec2 lines = 1.0 - dark.xz * dark.yw / (reach.xz * reach.yw);
	gl_FragColor = Floor(lines.x + 0.5 * lines.y, v_CameraHeight);
}
