// The floor: a unit square, spread to the extents (least x, least y, greatest x, greatest y).
uniform mat4 u_ViewProjection;
uniform vec3 u_Up;
uniform vec3 u_CameraPosition;
uniform vec4 u_Extents;
// Of the large lines, and of the small ones.
uniform vec2 u_GridSpacings;

attribute vec2 a_position;

varying vec4 v_Tiles;
varying float v_CameraHeight;

void main()
{
	vec2 place = mix(u_Extents.xy, u_Extents.zw, a_position);
	v_Tiles = place.xyxy / u_GridSpacings.xxyy;
	v_CameraHeight = dot(u_CameraPosition, u_Up);
	vec3 position = u_Up.y > 0.5 ? vec3(place.x, 0.0, place.y) : vec3(place, 0.0);
	gl_Position = u_ViewProjection * vec4(position, 1.0);
}
