// A force plate with a frame, lit like its surroundings.
uniform mat4 u_View;
uniform vec3 u_Up;

varying vec4 v_Colour;
varying vec3 v_Normal;
varying vec2 v_UV;

void main()
{
	float light = Light(normalize(v_Normal), ToCamera(u_View), u_Up, c_Lights);
	// Nearer to an edge than this is frame.
	vec2 edge = min(v_UV, 1.0 - v_UV);
	float frame = 1.0 - step(0.02, min(edge.x, edge.y));
	gl_FragColor = vec4(mix(v_Colour.rgb * light, vec3(1.0), 0.5 * frame), v_Colour.a);
}
