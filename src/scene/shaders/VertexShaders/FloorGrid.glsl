// The floor: a unit square, spread to the extents (least x, least y, greatest x, greatest y).
uniform mat4 u_ViewProjection;
uniform vec3 u_Up;
uniform vec3 u_CameraPosition;
uniform vec4 u_Extents;

attribute vec2 a_position;

varying vec2 v_Floor;
varying float v_CameraHeight;

void main()
{
	v_Floor = mix(u_Extents.xy, u_Extents.zw, a_position);
	v_CameraHeight = dot(u_CameraPosition, u_Up);
	vec3 position = u_Up.y > 0.5 ? vec3(v_Floor.x, 0.0, v_Floor.y) : vec3(v_Floor, 0.0);
	gl_Position = u_ViewProjection * vec4(position, 1.0);
}
